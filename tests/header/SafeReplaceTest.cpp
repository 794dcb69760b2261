// What a save must never lose: files behind links, other names of the same file, another
// program's changes, another user's file, and the file itself when the save is killed.
#include <gtest/gtest.h>

#include <csignal>
#include <grp.h>
#include <filesystem>
#include <set>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include "Dialogs.h"
#include "FileSave.h"
#include "FixedClock.h"
#include "QmError.h"
#include "SafeReplace.h"
#include "ScriptedDialogs.h"
#include "TempDir.h"

namespace fs = std::filesystem;

namespace {

const std::string OldBytes = "0 old\r\n1 16 a.dat\r\n";
const std::string NewBytes = "0 new\r\n";
const std::string BackupName = "real_Backup_2008-08-10_14-05-09.dat";

std::set<std::string> namesIn(const fs::path& folder)
{
    std::set<std::string> names;
    for (const auto& entry : fs::directory_iterator(folder))
        names.insert(entry.path().filename().string());
    return names;
}

struct stat statOf(const std::string& path)
{
    struct stat info {};
    ::lstat(path.c_str(), &info);
    return info;
}

class SavingLinks : public ::testing::TestWithParam<bool> {
protected:
    bool withBackup() const { return GetParam(); }
    std::optional<std::string> backup() const
    {
        return withBackup() ? std::optional(dir.file(BackupName)) : std::nullopt;
    }
    TempDir dir;
    const std::string real = dir.write("real.dat", OldBytes);
};

TEST_P(SavingLinks, SymbolicLinkWritesItsTargetAndStaysALink)
{
    fs::create_directory(dir.path() / "models");
    const auto link = dir.file("models/link.dat");
    fs::create_symlink("../real.dat", link);
    HeaderData h;
    h.FilePath = link;
    ScriptedDialogs dialogs;
    const auto result = FileSave(h, NewBytes, withBackup(), FixedClock(), dialogs);
    ASSERT_TRUE(result.saved);
    EXPECT_TRUE(fs::is_symlink(link));
    EXPECT_EQ(ReadBytes(real), NewBytes + "\r\n");
    if (withBackup()) {
        EXPECT_EQ(result.backupPath, dir.file(BackupName));
        EXPECT_TRUE(S_ISREG(statOf(result.backupPath).st_mode));
        EXPECT_EQ(ReadBytes(result.backupPath), OldBytes);
    }
    EXPECT_EQ(namesIn(dir.path() / "models"), std::set<std::string>{"link.dat"});
}

TEST_P(SavingLinks, EveryHardLinkShowsTheNewContent)
{
    const auto other = dir.file("other-name.dat");
    fs::create_hard_link(real, other);
    const auto inode = statOf(real).st_ino;
    ReplaceFileSafely(real, {NewBytes}, backup());
    EXPECT_EQ(ReadBytes(other), NewBytes);
    EXPECT_EQ(statOf(real).st_ino, inode);
    EXPECT_EQ(statOf(real).st_nlink, 2u);
    std::set<std::string> expected{"real.dat", "other-name.dat"};
    if (withBackup()) {
        EXPECT_EQ(ReadBytes(*backup()), OldBytes);
        expected.insert(BackupName);
    }
    EXPECT_EQ(namesIn(dir.path()), expected);
}

INSTANTIATE_TEST_SUITE_P(BackupOnAndOff, SavingLinks, ::testing::Bool());

TEST(ChangedOnDisk, AskedBeforeOverwritingAndNoKeepsTheOtherProgramsBytes)
{
    TempDir dir;
    HeaderData h;
    h.FilePath = dir.write("3001.dat", OldBytes);
    h.ReadStamp = StampOfPath(h.FilePath);
    h.FileChanged = true;
    const std::string theirs = OldBytes + "1 16 b.dat\r\n";
    TempDir::writeTo(h.FilePath, theirs);
    ScriptedDialogs dialogs;
    dialogs.expectMessage(Answer::No);
    EXPECT_FALSE(FileSave(h, NewBytes, false, FixedClock(), dialogs).saved);
    ASSERT_EQ(dialogs.messages.size(), 1u);
    const auto& box = dialogs.messages[0];
    EXPECT_EQ(box.title, "File Changed on Disk");
    EXPECT_EQ(box.text, "The file " + h.FilePath +
                            " was changed by another program after it was opened.\r\n"
                            "Save anyway and overwrite those changes?");
    EXPECT_EQ(box.buttons, Buttons::YesNo);
    EXPECT_EQ(box.icon, Icon::Exclamation);
    EXPECT_EQ(box.defaultButton, Answer::No);
    EXPECT_EQ(ReadBytes(h.FilePath), theirs);
    EXPECT_TRUE(h.FileChanged);

    dialogs.expectMessage(Answer::Yes);
    EXPECT_TRUE(FileSave(h, NewBytes, false, FixedClock(), dialogs).saved);
    EXPECT_EQ(ReadBytes(h.FilePath), NewBytes + "\r\n");
    // The stamp is now the saved file's: saving again asks nothing.
    h.FileChanged = true;
    EXPECT_TRUE(FileSave(h, NewBytes, false, FixedClock(), dialogs).saved);
    EXPECT_EQ(dialogs.messages.size(), 2u);

    fs::remove(h.FilePath); // a file that is gone counts as changed too
    dialogs.expectMessage(Answer::No);
    EXPECT_FALSE(FileSave(h, NewBytes, false, FixedClock(), dialogs).saved);
    EXPECT_FALSE(fs::exists(h.FilePath));
}

// Runs act in a child process as the user nobody; its exit status is what act returns.
int asNobody(const std::function<int()>& act)
{
    const pid_t child = ::fork();
    if (child == 0) {
        if (::setgroups(0, nullptr) != 0 || ::setresgid(65534, 65534, 65534) != 0 ||
            ::setresuid(65534, 65534, 65534) != 0)
            ::_exit(99);
        ::_exit(act());
    }
    int status = 0;
    ::waitpid(child, &status, 0);
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

int saveStatus(const std::string& path)
{
    try {
        ReplaceFileSafely(path, {NewBytes}, std::nullopt);
        return 0;
    } catch (const QmError& error) {
        return error.number();
    }
}

TEST(AnotherUsersFile, IsRefusedOrKeepsItsOwner)
{
    if (::geteuid() != 0)
        GTEST_SKIP() << "needs root to act as another user";
    TempDir dir;
    fs::permissions(dir.path(), fs::perms::all);
    const auto rootsOwn = dir.write("roots.dat", OldBytes);
    ::chmod(rootsOwn.c_str(), 0644);
    EXPECT_EQ(asNobody([&] { return saveStatus(rootsOwn); }), 70);
    EXPECT_EQ(ReadBytes(rootsOwn), OldBytes);
    EXPECT_EQ(statOf(rootsOwn).st_uid, 0u);

    // Writable for nobody through its mode, but owned by root: rewritten, and still root's.
    const auto shared = dir.write("shared.dat", OldBytes);
    ::chmod(shared.c_str(), 0666);
    EXPECT_EQ(asNobody([&] { return saveStatus(shared); }), 0);
    EXPECT_EQ(ReadBytes(shared), NewBytes);
    EXPECT_EQ(statOf(shared).st_uid, 0u);
    EXPECT_EQ(namesIn(dir.path()), (std::set<std::string>{"roots.dat", "shared.dat"}));
}

// A save killed right after each of its steps leaves the old or the new bytes under the part's
// name, the backup only with the old bytes, and nothing that the next save does not clear.
class KilledSave : public ::testing::TestWithParam<std::tuple<ReplaceStep, bool, bool>> {};

TEST_P(KilledSave, LeavesTheFileWholeAndNoLeftovers)
{
    const auto [step, withBackup, hardLinked] = GetParam();
    TempDir dir;
    const auto path = dir.write("real.dat", OldBytes);
    std::set<std::string> names{"real.dat"};
    if (hardLinked) {
        fs::create_hard_link(path, dir.file("second.dat"));
        names.insert("second.dat");
    }
    const auto backup = withBackup ? std::optional(dir.file(BackupName)) : std::nullopt;
    const pid_t child = ::fork();
    if (child == 0) {
        ReplaceFileSafely(path, {NewBytes}, backup, [step = step](ReplaceStep reached) {
            if (reached == step)
                ::raise(SIGKILL);
        });
        ::_exit(0);
    }
    int status = 0;
    ::waitpid(child, &status, 0);
    const auto bytes = ReadBytes(path);
    EXPECT_TRUE(bytes == OldBytes || bytes == NewBytes) << bytes;
    if (withBackup && fs::exists(*backup)) {
        EXPECT_EQ(ReadBytes(*backup), OldBytes);
        names.insert(BackupName);
    }
    // The next save clears whatever the killed one left, except the copy of a file it was
    // rewriting in place, which stays as the one whole copy of the old bytes.
    ReplaceFileSafely(path, {NewBytes}, std::nullopt);
    auto left = namesIn(dir.path());
    std::erase_if(left, [](const std::string& name) { return name.rfind(".quillmark-keep-", 0) == 0; });
    EXPECT_EQ(left, names);
}

INSTANTIATE_TEST_SUITE_P(EveryStep, KilledSave,
                         ::testing::Combine(::testing::Values(ReplaceStep::NewTextWritten, ReplaceStep::BackupMade,
                                                              ReplaceStep::NewTextNamed, ReplaceStep::Placed),
                                            ::testing::Bool(), ::testing::Bool()));

} // namespace
