// SPDX-License-Identifier: MIT
// The safe replace under attack: another user's file, a backup sharing the part's inode, other
// programs and other saves writing meanwhile, and the attributes that must travel with the text.
#include <gtest/gtest.h>

#include <cstring>
#include <fcntl.h>
#include <fstream>
#include <future>
#include <memory>
#include <sys/file.h>
#include <sys/wait.h>
#include <sys/xattr.h>
#include <thread>
#include <unistd.h>

#include "ErrorNumber.h"
#include "Processes.h"
#include "SafeReplace.h"
#include "TempDir.h"

namespace fs = std::filesystem;

namespace {

const std::string OldContent = "0 old\r\n1 16 a.dat\r\n";
const std::string NewContent = "0 new\r\n\r\n1 16 a.dat\r\n";
const std::string BackupName = "3001_Backup_1.dat";

ReplaceOptions withBackup(const std::string& backupPath)
{
    ReplaceOptions options;
    options.backupPath = backupPath;
    options.isBackupName = [](std::string_view name) { return name.starts_with("3001_Backup_"); };
    return options;
}

TEST(AnotherUsersFile, IsRefusedWhenOnlyItsOwnerMayWriteIt)
{
    if (::geteuid() != 0)
        GTEST_SKIP() << "needs root to act as another user";
    TempDir dir;
    fs::permissions(dir.path(), fs::perms::all);
    const auto saveStatus = [](const std::string& path) {
        return ErrorNumberOf([&path] { ReplaceFileSafely(path, {NewContent}); });
    };
    const auto rootsOwn = dir.write("roots.dat", OldContent);
    ::chmod(rootsOwn.c_str(), 0644); // writable for root alone, in a folder everyone may write
    EXPECT_EQ(WEXITSTATUS(WaitFor(StartChild(true, [&] { ::_exit(saveStatus(rootsOwn)); }))), 70);
    EXPECT_EQ(ReadBytes(rootsOwn), OldContent);
    EXPECT_EQ(NamesIn(dir.path()), std::set<std::string>{"roots.dat"});
}

// A user who may write the part but not its folder gets no backup there, and is told so in words
// before anything is written.
TEST(AnotherUsersFolder, SaysTheBackupCannotBeMadeThere)
{
    if (::geteuid() != 0)
        GTEST_SKIP() << "needs root to act as another user";
    TempDir dir;
    fs::permissions(dir.path(), fs::perms(0755));
    const auto path = dir.write("3001.dat", OldContent);
    ASSERT_EQ(::chown(path.c_str(), 65534, 65534), 0); // nobody's, in root's folder
    int said[2];
    ASSERT_EQ(::pipe(said), 0);
    WaitFor(StartChild(true, [&] {
        try {
            ReplaceFileSafely(path, {NewContent}, withBackup(dir.file(BackupName)));
        } catch (const QmError& error) {
            [[maybe_unused]] const auto written =
                ::write(said[1], error.description().data(), error.description().size());
        }
    }));
    ::close(said[1]);
    std::string message(512, '\0');
    message.resize(static_cast<std::size_t>(std::max<ssize_t>(0, ::read(said[0], message.data(), message.size()))));
    ::close(said[0]);
    EXPECT_EQ(message, "cannot make the backup " + dir.file(BackupName) + ": permission denied");
    EXPECT_EQ(ReadBytes(path), OldContent);
}

// A save killed between making the backup and renaming leaves the part and its backup as one
// file with two names: the next save replaces the part by rename and never writes into the backup.
TEST(BackupSharingThePartsInode, IsNeverWrittenInto)
{
    TempDir dir;
    const auto path = dir.write("3001.dat", OldContent);
    fs::create_hard_link(path, dir.file(BackupName));
    ReplaceFileSafely(path, {NewContent}, withBackup(dir.file("3001_Backup_2.dat")));
    EXPECT_EQ(ReadBytes(path), NewContent);
    EXPECT_EQ(ReadBytes(dir.file(BackupName)), OldContent);
    EXPECT_FALSE(fs::equivalent(path, dir.file(BackupName)));
}

// Another program appends to the part, or removes it, after the new text is on disk and before
// it takes the name, or writes to the old file it opened before in the instant between the last
// look and the rename: the save ends as changed and leaves the other program's work alone.
TEST(ChangedWhileSaving, EndsTheSaveAndKeepsTheOtherWrite)
{
    using Case = std::tuple<bool, bool, ReplaceStep>; // hard-linked, removed, when
    for (const auto& [hardLinked, removed, when] :
         {Case{false, false, ReplaceStep::BackupMade}, Case{false, true, ReplaceStep::BackupMade},
          Case{true, false, ReplaceStep::BackupMade}, Case{true, true, ReplaceStep::BackupMade},
          Case{false, false, ReplaceStep::NewTextNamed}}) {
        for (const bool backup : {false, true}) {
            TempDir dir;
            const auto path = dir.write("3001.dat", OldContent);
            if (hardLinked)
                fs::create_hard_link(path, dir.file("second.dat"));
            auto options = backup ? withBackup(dir.file(BackupName)) : ReplaceOptions{};
            options.expected = OpenPart::openPath(path)->stamp();
            options.afterStep = [&, removed = removed, when = when](ReplaceStep reached) {
                if (reached != when)
                    return;
                if (removed)
                    fs::remove(path);
                else
                    std::ofstream(path, std::ios::app) << "1 4 theirs.dat\r\n";
            };
            EXPECT_THROW(ReplaceFileSafely(path, {NewContent}, options), FileChangedError);
            EXPECT_EQ(ReadBytes(path), removed ? "" : OldContent + "1 4 theirs.dat\r\n");
            auto names = NamesIn(dir.path());
            names.erase("second.dat");
            EXPECT_EQ(names, removed ? std::set<std::string>{} : std::set<std::string>{"3001.dat"});
        }
    }
}

// A hard-linked part is rewritten in place, where the new text lands in the file another program
// has open. Its append, or its write over bytes already rewritten, after the last write and
// before the part is cut to length, is never cut away or overwritten unnoticed: the save fails,
// the file as it stood is in a copy beside the part, and the part holds its old bytes again.
TEST(ChangedWhileRewritingInPlace, FailsTheSaveAndKeepsTheOtherWrite)
{
    const std::string Shorter = "0 n\r\n";
    for (const bool append : {true, false}) {
        TempDir dir;
        const auto path = dir.write("3001.dat", OldContent);
        fs::create_hard_link(path, dir.file("second.dat"));
        ReplaceOptions options;
        options.afterStep = [&](ReplaceStep reached) {
            if (reached != ReplaceStep::WrittenInPlace)
                return;
            if (append)
                std::ofstream(path, std::ios::app) << "1 4 theirs.dat\r\n";
            else
                std::fstream(path, std::ios::in | std::ios::out) << "X";
        };
        try {
            ReplaceFileSafely(path, {Shorter}, options);
            ADD_FAILURE() << "saved; append " << append;
        } catch (const ChangedWhileSavingError& error) {
            const auto copy = dir.file("3001.dat.changed-while-saving");
            EXPECT_EQ(error.description(), path + ": changed while saving; the file as another program left it is in " +
                                               copy + ", and its old bytes are back");
            // The write over rewritten bytes is seen before or after the cut, as the clock's tick falls.
            if (append)
                EXPECT_EQ(ReadBytes(copy), Shorter + OldContent.substr(Shorter.size()) + "1 4 theirs.dat\r\n");
            else
                EXPECT_TRUE(ReadBytes(copy).starts_with("X" + Shorter.substr(1))) << ReadBytes(copy);
        }
        EXPECT_EQ(ReadBytes(path), OldContent);
        EXPECT_EQ(NamesIn(dir.path()),
                  (std::set<std::string>{"3001.dat", "second.dat", "3001.dat.changed-while-saving"}));
    }
}

// Another program that holds the part locked makes a save wait, for a while and no longer.
TEST(LockedPart, IsWaitedForUpToThePatience)
{
    TempDir dir;
    const auto path = dir.write("3001.dat", OldContent);
    const FileDescriptor holder(::open(path.c_str(), O_RDONLY | O_CLOEXEC));
    ASSERT_EQ(::flock(holder.get(), LOCK_EX), 0);
    ReplaceOptions options;
    options.lockWait.patience = std::chrono::milliseconds(100);
    auto save = std::async(std::launch::async, [&] { ReplaceFileSafely(path, {NewContent}, options); });
    // A watchdog: a save that waits for ever is let go, and fails the test.
    if (save.wait_for(std::chrono::seconds(30)) != std::future_status::ready) {
        ADD_FAILURE() << "the save still waits";
        ::flock(holder.get(), LOCK_UN);
    }
    EXPECT_THROW(save.get(), FileLockedError);
    EXPECT_EQ(ReadBytes(path), OldContent);
}

// What a killed save left in the part's folder goes with the next save there.
TEST(LeftoversOfKilledSaves, AreSweptByTheNextSave)
{
    TempDir dir;
    const auto path = dir.write("3001.dat", OldContent);
    dir.write(".quillmark-save-0123456789abcdef", "a killed save's text");
    std::this_thread::sleep_for(std::chrono::milliseconds(50)); // older than the save
    ReplaceFileSafely(path, {NewContent});
    EXPECT_EQ(NamesIn(dir.path()), std::set<std::string>{"3001.dat"});
}

// Another user who may write the folder swaps the part for a link to a file of the victim's
// between two steps of a save: the save writes, links and renames only the file it opened and
// names in its own folder, so the victim's file never changes, whatever the road and the step.
TEST(LinkPutInThePartsPlace, NeverLeadsTheSaveToAnotherFile)
{
    for (const bool hardLinked : {false, true}) {
        for (const auto step :
             {ReplaceStep::Locked, ReplaceStep::NewTextWritten, ReplaceStep::BackupMade, ReplaceStep::NewTextNamed}) {
            TempDir dir, victims;
            const auto victim = victims.write("private.txt", "the victim's own bytes");
            const auto path = dir.write("3001.dat", OldContent);
            if (hardLinked)
                fs::create_hard_link(path, dir.file("second.dat"));
            auto options = withBackup(dir.file(BackupName));
            options.afterStep = [&, step = step](ReplaceStep reached) {
                if (reached != step)
                    return;
                fs::rename(path, dir.file("moved.dat"));
                fs::create_symlink(victim, path);
            };
            try {
                ReplacePart(OpenPart::openPath(path), {NewContent}, options);
            } catch (const QmError&) {
                // a save that sees the swap may give up; it must not write elsewhere
            }
            EXPECT_EQ(ReadBytes(victim), "the victim's own bytes") << hardLinked << " " << static_cast<int>(step);
            EXPECT_EQ(NamesIn(victims.path()), std::set<std::string>{"private.txt"});
        }
    }
}

// A program that opened the old file before the rename writes to it a moment after: the save waits
// for it to close the file, sees the write and gives the old file its name back.
TEST(ChangedWhileSaving, ALateWriteToTheOldFileIsKept)
{
    TempDir dir;
    const auto path = dir.write("3001.dat", OldContent);
    ReplaceOptions options;
    std::jthread writer;
    options.afterStep = [&](ReplaceStep reached) {
        if (reached == ReplaceStep::NewTextNamed)
            writer = std::jthread([out = std::make_shared<std::ofstream>(path, std::ios::app)] {
                std::this_thread::sleep_for(std::chrono::milliseconds(20));
                *out << "1 4 theirs.dat\r\n";
            });
    };
    EXPECT_THROW(ReplaceFileSafely(path, {NewContent}, options), FileChangedError);
    EXPECT_EQ(ReadBytes(path), OldContent + "1 4 theirs.dat\r\n");
}

// Two saves of one file at once take turns: the second one checks after the first one has put its
// text in place, sees the change and writes nothing.
TEST(ConcurrentSaves, TheSecondSeesTheFirstAsAChange)
{
    TempDir dir;
    const auto path = dir.write("3001.dat", OldContent);
    ReplaceOptions first;
    first.expected = OpenPart::openPath(path)->stamp();
    int secondError = -1;
    std::jthread secondSave;
    first.afterStep = [&](ReplaceStep reached) {
        if (reached != ReplaceStep::NewTextNamed) // checked, not yet renamed
            return;
        secondSave = std::jthread([&, expected = first.expected] {
            ReplaceOptions second;
            second.expected = expected;
            secondError = ErrorNumberOf([&] { ReplaceFileSafely(path, {"0 second\r\n"}, second); });
        });
        std::this_thread::sleep_for(std::chrono::milliseconds(200)); // long enough to finish unhindered
    };
    ReplaceFileSafely(path, {"0 first\r\n"}, first);
    secondSave.join();
    EXPECT_EQ(secondError, 75);
    EXPECT_EQ(ReadBytes(path), "0 first\r\n");
}

// A POSIX access list as the system stores it (version 2; owner rw, user 12345 rw, group r, mask rw,
// others r): a colleague may write.
const std::string AccessList("\x02\0\0\0"
                             "\x01\0\x06\0\xff\xff\xff\xff"
                             "\x02\0\x06\0\x39\x30\0\0"
                             "\x04\0\x04\0\xff\xff\xff\xff"
                             "\x10\0\x06\0\xff\xff\xff\xff"
                             "\x20\0\x04\0\xff\xff\xff\xff",
                             44);

std::string attribute(const std::string& path, const char* name)
{
    std::string value(256, '\0');
    const auto size = ::getxattr(path.c_str(), name, value.data(), value.size());
    return size < 0 ? std::string("(none)") : value.substr(0, static_cast<std::size_t>(size));
}

TEST(Attributes, TravelWithTheText)
{
    TempDir dir;
    const auto path = dir.write("3001.dat", OldContent);
    const auto& acl = AccessList;
    if (::setxattr(path.c_str(), "user.origin", "scan", 4, 0) != 0 ||
        ::setxattr(path.c_str(), "system.posix_acl_access", acl.data(), acl.size(), 0) != 0)
        GTEST_SKIP() << "this file system keeps no extended attributes or access lists: " << std::strerror(errno);
    ReplaceFileSafely(path, {NewContent}, withBackup(dir.file(BackupName)));
    EXPECT_EQ(ReadBytes(path), NewContent);
    EXPECT_EQ(attribute(path, "user.origin"), "scan");
    EXPECT_EQ(attribute(path, "system.posix_acl_access"), acl);
}

} // namespace
