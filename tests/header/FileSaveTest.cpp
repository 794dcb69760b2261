// SPDX-License-Identifier: MIT
// Saving a part file: what ends on disk, and what a save must never lose: the old bytes when it
// fails, files behind links, other names of the same file, another program's changes, another
// user's file, and the file itself when the save is killed.
#include <gtest/gtest.h>

#include <unistd.h>

#include "Dialogs.h"
#include "ErrorNumber.h"
#include "FileSave.h"
#include "FixedClock.h"
#include "QmError.h"
#include "ScriptedDialogs.h"
#include "TempDir.h"

namespace fs = std::filesystem;

namespace {

const std::string OldContent = "0 old\r\n1 16 a.dat\r\n";
const std::string NewHeader = "0 new\r\n\r\n";
const std::string NewContent = "0 new\r\n\r\n1 16 a.dat\r\n";
const std::string BackupName = "3001_Backup_2008-08-10_14-05-09.dat";

TEST(MakeBackupName, StampBetweenBaseAndExtensionAndIsBackupNameKnowsItsNames)
{
    const LocalDateTime stamp{2008, 8, 10, 14, 5, 9};
    EXPECT_EQ(MakeBackupName("/parts/3001.dat", stamp), "/parts/3001_Backup_2008-08-10_14-05-09.dat");
    EXPECT_EQ(MakeBackupName("/parts/3001.old.dat", stamp), "/parts/3001_Backup_2008-08-10_14-05-09.old.dat");
    EXPECT_EQ(MakeBackupName("3001.dat", stamp), "3001_Backup_2008-08-10_14-05-09.dat");
    EXPECT_EQ(MakeBackupName("  ", stamp), "unbenannt_Backup_2008-08-10_14-05-09.txt");
    EXPECT_EQ(MakeBackupName(" parts/3001.dat ", stamp), " parts/3001_Backup_2008-08-10_14-05-09.dat ");
    EXPECT_THROW(MakeBackupName("/my.parts/3001", stamp), QmError);
    for (const auto* name : {"3001_Backup_2008-08-10_14-05-09.dat", "3001_Backup_2008-08-10_14-05-09 (12).old.dat"})
        EXPECT_TRUE(IsBackupName(name)) << name;
    for (const auto* name : {"3001_Backup_2008-08-10_14-05-09", "3001_Backup_2008-08-10_14-05-0x.dat",
                             "3001-Backup_2008-08-10_14-05-09.dat", "3001_Backup_2008-08-10_14-05-09 (x).dat"})
        EXPECT_FALSE(IsBackupName(name)) << name;
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
    // Saving fails with number, is reported, and the folder holds the old part file alone.
    void expectSaveFails(bool backup, int number)
    {
        dialogs = ScriptedDialogs();
        dialogs.expectMessage(Answer::Ok);
        EXPECT_FALSE(save(backup).saved);
        ASSERT_EQ(dialogs.messages.size(), 1u);
        EXPECT_EQ(dialogs.messages[0].text.rfind("Error " + std::to_string(number) + " (", 0), 0u)
            << dialogs.messages[0].text;
        EXPECT_TRUE(h.FileChanged);
        EXPECT_EQ(ReadBytes(h.FilePath), OldContent);
        EXPECT_EQ(NamesIn(dir.path()), std::set<std::string>{fs::path(h.FilePath).filename().string()});
    }

    TempDir dir;
    HeaderData h;
    ScriptedDialogs dialogs;
    FixedClock clock;
};

TEST_F(FileSaving, WritesTheNewTextKeepingPermissionsAndTheOldInTheBackup)
{
    ::chmod(h.FilePath.c_str(), 0640);
    EXPECT_TRUE(save(false).saved);
    EXPECT_FALSE(h.FileChanged);
    EXPECT_EQ(NamesIn(dir.path()), std::set<std::string>{"3001.dat"});
    EXPECT_EQ(StatOf(h.FilePath).st_mode & 0777, 0640u);
    TempDir::writeTo(h.FilePath, OldContent);
    h.ReadStamp.reset();
    h.ByteOrderMark = true; // read before the first line, and written back there
    const auto result = save(true);
    EXPECT_EQ(result.backupPath, dir.file(BackupName));
    EXPECT_EQ(ReadBytes(result.backupPath), OldContent);
    EXPECT_EQ(ReadBytes(h.FilePath), "\xEF\xBB\xBF" + NewContent);
}

TEST_F(FileSaving, ABackupNameIsNeverOverwrittenButNumbered)
{
    ASSERT_TRUE(save(true).saved);
    h.Body = "2 24 b";
    const auto second = save(true); // the same second: the name is taken
    ASSERT_TRUE(second.saved);
    EXPECT_EQ(second.backupPath, dir.file("3001_Backup_2008-08-10_14-05-09 (2).dat"));
    EXPECT_EQ(ReadBytes(second.backupPath), NewContent);
    EXPECT_EQ(ReadBytes(dir.file(BackupName)), OldContent);
}

TEST_F(FileSaving, RefusedSavesAreReportedAndWriteNothing)
{
    fs::rename(h.FilePath, dir.file("README"));
    h.FilePath = dir.file("README");
    expectSaveFails(true, 5); // no "." for the backup's name
    fs::rename(h.FilePath, dir.file("3001.dat"));
    h.FilePath = dir.file("3001.dat");
    ::chmod(h.FilePath.c_str(), 0444);
    expectSaveFails(false, 70);
    expectSaveFails(true, 70);
    h.FilePath = (dir.path() / "gone" / "3001.dat").string();
    dialogs = ScriptedDialogs();
    dialogs.expectMessage(Answer::Ok);
    EXPECT_FALSE(save(false).saved);
    EXPECT_EQ(dialogs.messages.back().text.rfind("Error 76 (", 0), 0u);
}

TEST_F(FileSaving, RelativePathKeepsItsBackupBesideIt)
{
    const auto previous = fs::current_path();
    fs::current_path(dir.path());
    h.FilePath = "3001.dat";
    const auto result = save(true);
    fs::current_path(previous);
    EXPECT_EQ(result.backupPath, BackupName);
    EXPECT_EQ(ReadBytes(dir.file(BackupName)), OldContent);
}

TEST_F(FileSaving, ThroughASymbolicLinkTheTargetIsWrittenAndTheLinkStays)
{
    fs::create_directory(dir.path() / "models");
    h.FilePath = dir.file("models/link.dat");
    fs::create_symlink("../3001.dat", h.FilePath);
    const auto result = save(true);
    ASSERT_TRUE(result.saved);
    EXPECT_TRUE(fs::is_symlink(h.FilePath));
    EXPECT_EQ(ReadBytes(dir.file("3001.dat")), NewContent);
    EXPECT_EQ(result.backupPath, dir.file(BackupName));
    EXPECT_TRUE(S_ISREG(StatOf(result.backupPath).st_mode));
    EXPECT_EQ(ReadBytes(result.backupPath), OldContent);
    EXPECT_EQ(NamesIn(dir.path() / "models"), std::set<std::string>{"link.dat"});
}

TEST_F(FileSaving, EveryHardLinkShowsTheNewContent)
{
    fs::create_hard_link(h.FilePath, dir.file("other.dat"));
    const auto inode = StatOf(h.FilePath).st_ino;
    for (const bool backup : {false, true})
        ASSERT_TRUE(save(backup).saved);
    EXPECT_EQ(ReadBytes(dir.file("other.dat")), NewContent);
    EXPECT_EQ(StatOf(h.FilePath).st_ino, inode);
    EXPECT_EQ(ReadBytes(dir.file(BackupName)), NewContent); // a copy, not a third name
    EXPECT_EQ(NamesIn(dir.path()), (std::set<std::string>{"3001.dat", "other.dat", BackupName}));
}

TEST_F(FileSaving, AFileChangedOnDiskIsOverwrittenOnlyAfterAsking)
{
    h.ReadStamp = OpenPart::openPath(h.FilePath)->stamp();
    const std::string theirs = OldContent + "1 16 b.dat\r\n";
    TempDir::writeTo(h.FilePath, theirs);
    dialogs.expectMessage(Answer::No);
    EXPECT_FALSE(save(false).saved);
    const auto& box = dialogs.messages[0];
    EXPECT_EQ(box.title, "File Changed on Disk");
    EXPECT_NE(box.text.find(h.FilePath), std::string::npos);
    EXPECT_EQ(box.defaultButton, Answer::No);
    EXPECT_EQ(ReadBytes(h.FilePath), theirs);
    EXPECT_TRUE(h.FileChanged);

    dialogs.expectMessage(Answer::Yes);
    EXPECT_TRUE(save(false).saved);
    EXPECT_EQ(ReadBytes(h.FilePath), NewContent);
    EXPECT_TRUE(save(false).saved); // the stamp is now the saved file's: no question
    EXPECT_EQ(dialogs.messages.size(), 2u);
    fs::remove(h.FilePath); // a file that is gone counts as changed too
    dialogs.expectMessage(Answer::No);
    EXPECT_FALSE(save(false).saved);
}

} // namespace
