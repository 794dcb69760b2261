#include <gtest/gtest.h>

#include <filesystem>
#include <set>
#include <sys/mount.h>
#include <sys/stat.h>
#include <unistd.h>

#include "FileSave.h"
#include "FixedClock.h"
#include "QmError.h"
#include "ScriptedDialogs.h"
#include "TempDir.h"

namespace fs = std::filesystem;

namespace {

std::set<std::string> namesIn(const fs::path& folder)
{
    std::set<std::string> names;
    for (const auto& entry : fs::directory_iterator(folder))
        names.insert(entry.path().filename().string());
    return names;
}

TEST(MakeBackupName, StampBetweenBaseAndExtension)
{
    const LocalDateTime stamp{2008, 8, 10, 14, 5, 9};
    EXPECT_EQ(MakeBackupName("/parts/3001.dat", stamp), "/parts/3001_Backup_2008-08-10_14-05-09.dat");
    EXPECT_EQ(MakeBackupName("/parts/3001.old.dat", stamp), "/parts/3001_Backup_2008-08-10_14-05-09.old.dat");
    EXPECT_EQ(MakeBackupName("/3001.dat", stamp), "/3001_Backup_2008-08-10_14-05-09.dat");
    EXPECT_EQ(MakeBackupName("3001.dat", stamp), "3001_Backup_2008-08-10_14-05-09.dat");
    EXPECT_EQ(MakeBackupName("  ", stamp), "unbenannt_Backup_2008-08-10_14-05-09.txt");
    EXPECT_THROW(MakeBackupName("/my.parts/3001", stamp), QmError);
}

class FileSaving : public ::testing::Test {
protected:
    FileSaving()
    {
        h.FilePath = dir.write("3001.dat", OldContent);
        h.Body = "1 16 a.dat";
        h.FileChanged = true;
    }
    FileSaveResult save(bool backup) { return FileSave(h, NewHeader, backup, clock, dialogs); }
    void expectReported(int number)
    {
        ASSERT_EQ(dialogs.messages.size(), 1u);
        EXPECT_EQ(dialogs.messages[0].text.rfind("Error " + std::to_string(number) + " (", 0), 0u) << dialogs.messages[0].text;
        EXPECT_NE(dialogs.messages[0].text.find(") in procedure FileSave of Module modQuillmark"), std::string::npos);
        EXPECT_TRUE(h.FileChanged);
    }

    // Saving with and without backup fails with number, and folder holds the old part file alone.
    void expectEverySaveFails(int number, const fs::path& folder)
    {
        for (const bool backup : {false, true}) {
            dialogs = ScriptedDialogs();
            dialogs.expectMessage(Answer::Ok);
            EXPECT_FALSE(save(backup).saved);
            expectReported(number);
            EXPECT_EQ(ReadBytes(h.FilePath), OldContent);
            EXPECT_EQ(namesIn(folder), std::set<std::string>{"3001.dat"});
        }
    }

    const std::string OldContent = "0 old\r\n1 16 a.dat\r\n";
    const std::string NewHeader = "0 new\r\n\r\n";
    const std::string NewContent = "0 new\r\n\r\n1 16 a.dat\r\n";
    TempDir dir;
    HeaderData h;
    ScriptedDialogs dialogs;
    FixedClock clock;
};

TEST_F(FileSaving, WithoutBackupReplacesTheFile)
{
    EXPECT_TRUE(save(false).saved);
    EXPECT_TRUE(save(false).saved);
    EXPECT_EQ(ReadBytes(h.FilePath), NewContent);
    EXPECT_FALSE(h.FileChanged);
    EXPECT_EQ(namesIn(dir.path()), std::set<std::string>{"3001.dat"});
}

TEST_F(FileSaving, KeepsThePermissionsOfTheFile)
{
    ::chmod(h.FilePath.c_str(), 0640);
    ASSERT_TRUE(save(false).saved);
    struct stat info {};
    ::stat(h.FilePath.c_str(), &info);
    EXPECT_EQ(info.st_mode & 0777, 0640u);
}

TEST_F(FileSaving, BackupHoldsTheOldContent)
{
    const auto result = save(true);
    EXPECT_TRUE(result.saved);
    EXPECT_EQ(result.backupPath, dir.file("3001_Backup_2008-08-10_14-05-09.dat"));
    EXPECT_EQ(ReadBytes(result.backupPath), OldContent);
    EXPECT_EQ(ReadBytes(h.FilePath), NewContent);
}

TEST_F(FileSaving, TwoSavesInTwoSecondsLeaveTwoBackups)
{
    ASSERT_TRUE(save(true).saved);
    h.Body = "2 24 b";
    h.FileChanged = true;
    clock.set({2008, 8, 10, 14, 5, 10});
    ASSERT_TRUE(save(true).saved);
    EXPECT_EQ(namesIn(dir.path()), (std::set<std::string>{"3001.dat", "3001_Backup_2008-08-10_14-05-09.dat",
                                                          "3001_Backup_2008-08-10_14-05-10.dat"}));
    EXPECT_EQ(ReadBytes(dir.file("3001_Backup_2008-08-10_14-05-09.dat")), OldContent);
    EXPECT_EQ(ReadBytes(dir.file("3001_Backup_2008-08-10_14-05-10.dat")), NewContent);
}

TEST_F(FileSaving, SecondSaveInTheSameSecondFailsOnTheExistingBackup)
{
    ASSERT_TRUE(save(true).saved);
    h.Body = "2 24 b";
    h.FileChanged = true;
    dialogs.expectMessage(Answer::Ok);
    EXPECT_FALSE(save(true).saved);
    expectReported(58);
    EXPECT_EQ(ReadBytes(h.FilePath), NewContent);
    EXPECT_EQ(namesIn(dir.path()), (std::set<std::string>{"3001.dat", "3001_Backup_2008-08-10_14-05-09.dat"}));
}

TEST_F(FileSaving, NameWithoutDotCannotBeBackedUp)
{
    h.FilePath = dir.write("README", OldContent);
    dialogs.expectMessage(Answer::Ok);
    EXPECT_FALSE(save(true).saved);
    expectReported(5);
    EXPECT_EQ(ReadBytes(h.FilePath), OldContent);
}

TEST_F(FileSaving, MissingPartFileWithBackupIsReportedAndNothingIsWritten)
{
    fs::remove(h.FilePath);
    dialogs.expectMessage(Answer::Ok);
    EXPECT_FALSE(save(true).saved);
    expectReported(53);
    EXPECT_TRUE(namesIn(dir.path()).empty());
}

TEST_F(FileSaving, ReadOnlyPartFileIsNotOverwritten)
{
    ::chmod(h.FilePath.c_str(), 0444);
    expectEverySaveFails(70, dir.path());
}

TEST_F(FileSaving, FolderThatDisappearedIsReportedAsPathNotFound)
{
    h.FilePath = (dir.path() / "gone" / "3001.dat").string();
    for (const bool backup : {false, true}) {
        dialogs = ScriptedDialogs();
        dialogs.expectMessage(Answer::Ok);
        EXPECT_FALSE(save(backup).saved);
        expectReported(76);
    }
    EXPECT_TRUE(namesIn(dir.path()).size() == 1u);
}

TEST_F(FileSaving, RelativePathKeepsItsBackupBesideIt)
{
    const auto previous = fs::current_path();
    fs::current_path(dir.path());
    h.FilePath = "3001.dat";
    const auto result = save(true);
    fs::current_path(previous);
    EXPECT_TRUE(result.saved);
    EXPECT_EQ(result.backupPath, "3001_Backup_2008-08-10_14-05-09.dat");
    EXPECT_EQ(ReadBytes(dir.file(result.backupPath)), OldContent);
}

// A small file system of our own, for the faults that permissions cannot make for root.
class ScratchMount {
public:
    ScratchMount(const fs::path& at, const char* options)
        : at_(at), mounted_(::mount("tmpfs", at.c_str(), "tmpfs", 0, options) == 0)
    {
    }
    ~ScratchMount()
    {
        if (mounted_)
            ::umount(at_.c_str());
    }
    ScratchMount(const ScratchMount&) = delete;
    ScratchMount& operator=(const ScratchMount&) = delete;
    bool mounted() const { return mounted_; }
    bool makeReadOnly() { return ::mount(nullptr, at_.c_str(), nullptr, MS_REMOUNT | MS_RDONLY, nullptr) == 0; }

private:
    fs::path at_;
    bool mounted_;
};

TEST_F(FileSaving, ReadOnlyFolderKeepsTheOldFile)
{
    const auto folder = dir.path() / "ro";
    fs::create_directory(folder);
    ScratchMount mount(folder, "size=1m");
    const bool asRoot = ::geteuid() == 0;
    if (asRoot && !mount.mounted())
        GTEST_SKIP() << "running as root without the right to mount a read-only folder";
    h.FilePath = (folder / "3001.dat").string();
    TempDir::writeTo(h.FilePath, OldContent);
    if (asRoot)
        ASSERT_TRUE(mount.makeReadOnly());
    else
        fs::permissions(folder, fs::perms::owner_read | fs::perms::owner_exec);
    expectEverySaveFails(70, folder);
    if (!asRoot)
        fs::permissions(folder, fs::perms::owner_all);
}

TEST_F(FileSaving, FullDiskKeepsTheOldFile)
{
    const auto folder = dir.path() / "full";
    fs::create_directory(folder);
    ScratchMount mount(folder, "size=64k");
    if (!mount.mounted())
        GTEST_SKIP() << "cannot mount a small file system here to fill it";
    h.FilePath = (folder / "3001.dat").string();
    TempDir::writeTo(h.FilePath, OldContent);
    h.Body.assign(256 * 1024, '1');
    expectEverySaveFails(61, folder);
    // A file with a second name is rewritten in place: when that fails, its old bytes come back.
    fs::create_hard_link(h.FilePath, folder / "second.dat");
    dialogs = ScriptedDialogs();
    dialogs.expectMessage(Answer::Ok);
    EXPECT_FALSE(save(false).saved);
    expectReported(61);
    EXPECT_EQ(ReadBytes((folder / "second.dat").string()), OldContent);
    EXPECT_EQ(namesIn(folder), (std::set<std::string>{"3001.dat", "second.dat"}));
}

} // namespace
