// The safe replace under attack: another user's file, a save killed after each of its steps, a
// rewrite torn in the middle, other programs and other saves writing meanwhile, and the
// attributes that must travel with the text.
#include <gtest/gtest.h>

#include <condition_variable>
#include <csignal>
#include <cstring>
#include <fstream>
#include <functional>
#include <grp.h>
#include <mutex>
#include <sys/stat.h>
#include <sys/wait.h>
#include <sys/xattr.h>
#include <thread>
#include <unistd.h>

#include "ErrorNumber.h"
#include "SafeReplace.h"
#include "TempDir.h"

namespace fs = std::filesystem;

namespace {

const std::string OldContent = "0 old\r\n1 16 a.dat\r\n";
const std::string NewContent = "0 new\r\n\r\n1 16 a.dat\r\n";
const std::string BackupName = "3001_Backup_1.dat";

struct stat statOf(const std::string& path)
{
    struct stat info {};
    ::lstat(path.c_str(), &info);
    return info;
}

ReplaceOptions withBackup(const std::string& backupPath)
{
    ReplaceOptions options;
    options.backupPath = backupPath;
    options.isBackupName = [](std::string_view name) { return name.starts_with("3001_Backup_"); };
    return options;
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

TEST(AnotherUsersFile, IsRefusedOrKeepsItsOwner)
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
    EXPECT_EQ(asNobody([&] { return saveStatus(rootsOwn); }), 70);
    EXPECT_EQ(ReadBytes(rootsOwn), OldContent);
    const auto shared = dir.write("shared.dat", OldContent);
    ::chmod(shared.c_str(), 0666); // writable for nobody too: rewritten, and still root's
    EXPECT_EQ(asNobody([&] { return saveStatus(shared); }), 0);
    EXPECT_EQ(ReadBytes(shared), NewContent);
    EXPECT_EQ(statOf(shared).st_uid, 0u);
    EXPECT_EQ(NamesIn(dir.path()), (std::set<std::string>{"roots.dat", "shared.dat"}));
    fs::permissions(dir.path(), fs::perms::owner_all | fs::perms::others_exec); // no new files for nobody
    TempDir::writeTo(shared, OldContent);
    EXPECT_EQ(asNobody([&] { return saveStatus(shared); }), 0);
    EXPECT_EQ(ReadBytes(shared), NewContent);
}

// A save killed right after each of its steps leaves the old or the new bytes under the part's
// name, the backup only with the old bytes on an inode of its own once the next save is done,
// and nothing that the next open does not clear.
class KilledSave : public ::testing::TestWithParam<std::tuple<ReplaceStep, bool, bool>> {};

TEST_P(KilledSave, LeavesTheFileWholeAndNoLeftovers)
{
    const auto [step, backup, hardLinked] = GetParam();
    TempDir dir;
    const auto path = dir.write("3001.dat", OldContent);
    std::set<std::string> names{"3001.dat"};
    if (hardLinked) {
        fs::create_hard_link(path, dir.file("second.dat"));
        names.insert("second.dat");
    }
    auto options = backup ? withBackup(dir.file(BackupName)) : ReplaceOptions{};
    options.afterStep = [step = step](ReplaceStep reached) {
        if (reached == step)
            ::raise(SIGKILL);
    };
    if (::fork() == 0) {
        ReplaceFileSafely(path, {NewContent}, options);
        ::_exit(0);
    }
    ::wait(nullptr);
    RestoreInterruptedSave(path);
    const auto bytes = ReadBytes(path);
    EXPECT_TRUE(bytes == OldContent || bytes == NewContent) << bytes;
    const bool backupMade = backup && fs::exists(dir.file(BackupName));
    if (backupMade)
        names.insert(BackupName);
    EXPECT_EQ(NamesIn(dir.path()), names);
    options.afterStep = {};
    options.backupPath = dir.file("3001_Backup_2.dat");
    ReplaceFileSafely(path, {"0 next\r\n"}, options);
    if (backupMade) {
        EXPECT_EQ(ReadBytes(dir.file(BackupName)), OldContent);
        EXPECT_NE(statOf(dir.file(BackupName)).st_ino, statOf(path).st_ino);
    }
    EXPECT_EQ(ReadBytes(path), "0 next\r\n");
}

INSTANTIATE_TEST_SUITE_P(EveryStep, KilledSave,
                         ::testing::Combine(::testing::Values(ReplaceStep::NewTextWritten, ReplaceStep::BackupMade,
                                                              ReplaceStep::NewTextNamed, ReplaceStep::Placed),
                                            ::testing::Bool(), ::testing::Bool()));

// Killed in the middle of an in-place rewrite: the next open writes the old bytes back, once,
// and leaves a file that holds the complete new text as it is.
TEST(TornRewrite, IsUndoneByTheNextOpen)
{
    for (const bool completed : {false, true}) {
        TempDir dir;
        const auto path = dir.write("3001.dat", OldContent);
        fs::create_hard_link(path, dir.file("second.dat"));
        ReplaceOptions options;
        options.afterStep = [](ReplaceStep reached) {
            if (reached == ReplaceStep::BackupMade)
                ::raise(SIGKILL);
        };
        if (::fork() == 0) {
            ReplaceFileSafely(path, {NewContent}, options);
            ::_exit(0);
        }
        ::wait(nullptr);
        const auto inode = statOf(path).st_ino;
        const auto torn = completed ? NewContent : NewContent.substr(0, 9) + OldContent.substr(9);
        TempDir::writeTo(path, torn);
        EXPECT_EQ(RestoreInterruptedSave(dir.file("second.dat")), !completed);
        EXPECT_EQ(ReadBytes(path), completed ? NewContent : OldContent);
        EXPECT_EQ(statOf(path).st_ino, inode);
        EXPECT_EQ(NamesIn(dir.path()), (std::set<std::string>{"3001.dat", "second.dat"}));
        EXPECT_FALSE(RestoreInterruptedSave(path));
    }
}

// Another program appends to the part, or removes it, after the new text is on disk and before
// it takes the name, or writes to the old file it opened before in the instant between the last
// look and the rename: the save ends as changed and leaves the other program's work alone.
TEST(ChangedWhileSaving, EndsTheSaveAndKeepsTheOtherWrite)
{
    struct Case {
        bool hardLinked, removed;
        ReplaceStep when;
    };
    for (const auto [hardLinked, removed, when] :
         {Case{false, false, ReplaceStep::BackupMade}, Case{false, true, ReplaceStep::BackupMade},
          Case{true, false, ReplaceStep::BackupMade}, Case{true, true, ReplaceStep::BackupMade},
          Case{false, false, ReplaceStep::NewTextNamed}}) {
        for (const bool backup : {false, true}) {
            TempDir dir;
            const auto path = dir.write("3001.dat", OldContent);
            if (hardLinked)
                fs::create_hard_link(path, dir.file("second.dat"));
            auto options = backup ? withBackup(dir.file(BackupName)) : ReplaceOptions{};
            options.expected = StampOfPath(path);
            options.afterStep = [&, removed = removed, when = when](ReplaceStep reached) {
                if (reached != when)
                    return;
                if (removed)
                    fs::remove(path);
                else
                    std::ofstream(path, std::ios::app) << "1 4 theirs.dat\r\n";
            };
            EXPECT_THROW(ReplaceFileSafely(path, {NewContent}, options), FileChangedError);
            EXPECT_EQ(fs::exists(path), !removed);
            if (!removed) {
                EXPECT_EQ(ReadBytes(path), OldContent + "1 4 theirs.dat\r\n");
            }
            auto names = NamesIn(dir.path());
            names.erase("second.dat");
            EXPECT_EQ(names, removed ? std::set<std::string>{} : std::set<std::string>{"3001.dat"});
        }
    }
}

// Two saves of one file at once take turns: the second one checks after the first one has put its
// text in place, sees the change and writes nothing.
TEST(ConcurrentSaves, TheSecondSeesTheFirstAsAChange)
{
    TempDir dir;
    const auto path = dir.write("3001.dat", OldContent);
    const auto expected = StampOfPath(path);
    std::mutex mutex;
    std::condition_variable changed;
    bool firstChecked = false, released = false;
    ReplaceOptions first;
    first.expected = expected;
    first.afterStep = [&](ReplaceStep reached) {
        if (reached != ReplaceStep::NewTextNamed) // checked, not yet renamed
            return;
        std::unique_lock lock(mutex);
        firstChecked = true;
        changed.notify_all();
        changed.wait(lock, [&] { return released; });
    };
    std::jthread firstSave([&] { ReplaceFileSafely(path, {"0 first\r\n"}, first); });
    {
        std::unique_lock lock(mutex);
        changed.wait(lock, [&] { return firstChecked; });
    }
    int secondError = -1;
    std::jthread secondSave([&] {
        ReplaceOptions second;
        second.expected = expected;
        secondError = ErrorNumberOf([&] { ReplaceFileSafely(path, {"0 second\r\n"}, second); });
    });
    std::this_thread::sleep_for(std::chrono::milliseconds(200)); // long enough to finish unhindered
    {
        const std::lock_guard lock(mutex);
        released = true;
        changed.notify_all();
    }
    firstSave.join();
    secondSave.join();
    EXPECT_EQ(secondError, 75);
    EXPECT_EQ(ReadBytes(path), "0 first\r\n");
}

// A POSIX access list with a named user, as the system stores it: a colleague may write.
std::string accessListGranting(uid_t colleague)
{
    const auto entry = [](std::uint16_t tag, std::uint16_t permissions, std::uint32_t id) {
        std::string bytes(8, '\0');
        std::memcpy(bytes.data(), &tag, 2);
        std::memcpy(bytes.data() + 2, &permissions, 2);
        std::memcpy(bytes.data() + 4, &id, 4);
        return bytes;
    };
    constexpr std::uint32_t Version = 2, Undefined = 0xFFFFFFFF;
    std::string acl(4, '\0');
    std::memcpy(acl.data(), &Version, 4);
    return acl + entry(0x01, 6, Undefined) + entry(0x02, 6, colleague) + entry(0x04, 4, Undefined) +
           entry(0x10, 6, Undefined) + entry(0x20, 4, Undefined);
}

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
    const auto acl = accessListGranting(12345);
    if (::setxattr(path.c_str(), "user.origin", "scan", 4, 0) != 0 ||
        ::setxattr(path.c_str(), "system.posix_acl_access", acl.data(), acl.size(), 0) != 0)
        GTEST_SKIP() << "this file system keeps no extended attributes or access lists: " << std::strerror(errno);
    ReplaceFileSafely(path, {NewContent}, withBackup(dir.file(BackupName)));
    EXPECT_EQ(ReadBytes(path), NewContent);
    EXPECT_EQ(attribute(path, "user.origin"), "scan");
    EXPECT_EQ(attribute(path, "system.posix_acl_access"), acl);
    EXPECT_EQ(attribute(dir.file(BackupName), "user.origin"), "scan");
}

} // namespace
