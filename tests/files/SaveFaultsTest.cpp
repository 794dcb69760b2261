// SPDX-License-Identifier: MIT
// Saving when the system fails one of its calls. The calls are intercepted in this test program
// alone: a call named in failNext fails once with failErrno, and every call is recorded.
#include <gtest/gtest.h>

#include <cerrno>
#include <cstdarg>
#include <dlfcn.h>
#include <fcntl.h>
#include <filesystem>
#include <unistd.h>

#include "ErrorNumber.h"
#include "PartFile.h"
#include "SafeReplace.h"
#include "TempDir.h"

namespace {

std::vector<std::string> calls;
std::string failNext;
int failErrno = EIO;
long physicalPages = 0; // what the system is said to have, when not 0

template <typename Real, typename... Args>
auto intercept(const char* name, Real* real, Args... args) -> decltype(real(args...))
{
    calls.emplace_back(name);
    if (failNext == name) {
        failNext.clear();
        errno = failErrno;
        return -1;
    }
    return real(args...);
}

template <typename Function>
Function* realFunction(const char* name)
{
    return reinterpret_cast<Function*>(::dlsym(RTLD_NEXT, name));
}

} // namespace

extern "C" {
int fsync(int fd) { return intercept("fsync", realFunction<int(int)>("fsync"), fd); }
ssize_t write(int fd, const void* bytes, size_t size)
{
    return intercept("write", realFunction<ssize_t(int, const void*, size_t)>("write"), fd, bytes, size);
}
int ftruncate(int fd, off_t size) noexcept
{
    return intercept("ftruncate", realFunction<int(int, off_t)>("ftruncate"), fd, size);
}
// Only the closing of a file written can fail as a full disk makes it fail.
int close(int fd)
{
    const auto real = realFunction<int(int)>("close");
    const int mode = ::fcntl(fd, F_GETFL);
    return mode >= 0 && (mode & O_ACCMODE) != O_RDONLY ? intercept("close", real, fd) : real(fd);
}
int fchmod(int fd, mode_t mode) noexcept
{
    return intercept("fchmod", realFunction<int(int, mode_t)>("fchmod"), fd, mode);
}
int renameat(int fromFolder, const char* from, int toFolder, const char* to) noexcept
{
    return intercept("renameat", realFunction<int(int, const char*, int, const char*)>("renameat"), fromFolder, from,
                     toFolder, to);
}
int fchown(int fd, uid_t owner, gid_t group) noexcept
{
    return intercept("fchown", realFunction<int(int, uid_t, gid_t)>("fchown"), fd, owner, group);
}
// The flags name the call: "openat O_TMPFILE" for an unnamed temporary file.
int openat(int folder, const char* path, int flags, ...)
{
    va_list rest;
    va_start(rest, flags);
    const auto mode = (flags & O_CREAT) != 0 || (flags & O_TMPFILE) == O_TMPFILE ? va_arg(rest, mode_t) : 0;
    va_end(rest);
    const auto real = realFunction<int(int, const char*, int, ...)>("openat");
    if ((flags & O_TMPFILE) == O_TMPFILE)
        return intercept("openat O_TMPFILE", real, folder, path, flags, mode);
    return real(folder, path, flags, mode);
}
long sysconf(int name) noexcept
{
    const auto real = realFunction<long(int)>("sysconf");
    if (name == _SC_PHYS_PAGES && physicalPages > 0)
        return physicalPages;
    return real(name);
}
int linkat(int fromFolder, const char* from, int toFolder, const char* to, int flags) noexcept
{
    return intercept("linkat", realFunction<int(int, const char*, int, const char*, int)>("linkat"), fromFolder, from,
                     toFolder, to, flags);
}
}

namespace {

const std::string OldBytes = "0 old\r\n";
const std::string NewBytes = "0 new\r\n";

class SaveFaults : public ::testing::Test {
protected:
    ~SaveFaults() override { failNext.clear(); }
    // The number of the error a save reports when step fails with error, 0 when it succeeds.
    int failureNumber(const char* step, int error, bool withBackup)
    {
        failNext = step;
        failErrno = error;
        return ErrorNumberOf([this, withBackup] {
            ReplaceOptions options;
            if (withBackup)
                options.backupPath = backup;
            ReplaceFileSafely(path, {NewBytes}, options);
        });
    }
    TempDir dir;
    const std::string path = dir.write("3001.dat", OldBytes);
    const std::string backup = dir.file("3001_Backup.dat");
};

TEST_F(SaveFaults, TheNewTextIsOnDiskBeforeItTakesTheNameAndTheFolderAfter)
{
    calls.clear();
    ReplaceFileSafely(path, {NewBytes});
    std::vector<std::string> order;
    for (const auto& call : calls)
        if (call == "fsync" || call == "renameat")
            order.push_back(call);
    EXPECT_EQ(order, (std::vector<std::string>{"fsync", "renameat", "fsync"}));
    EXPECT_EQ(ReadBytes(path), NewBytes);
}

TEST_F(SaveFaults, AFailingStepKeepsTheOldFileAndLeavesNothingBehind)
{
    for (const char* step : {"write", "fchmod", "fsync", "linkat", "close", "renameat"}) {
        for (const bool withBackup : {false, true}) {
            // Without a backup, the first link only gives the old file a spare name, which the save
            // does without.
            if (std::string(step) == "linkat" && !withBackup)
                continue;
            EXPECT_EQ(failureNumber(step, ENOSPC, withBackup), 61) << step; // "Disk full"
            EXPECT_EQ(ReadBytes(path), OldBytes) << step;
            EXPECT_EQ(NamesIn(dir.path()), std::set<std::string>{"3001.dat"}) << step << " " << withBackup;
        }
    }
}

// A file with a second name is rewritten in place: when that fails, its old bytes come back.
TEST_F(SaveFaults, AFailedRewriteInPlaceBringsBackTheOldBytes)
{
    std::filesystem::create_hard_link(path, dir.file("second.dat"));
    EXPECT_EQ(failureNumber("ftruncate", EIO, false), 57);
    EXPECT_EQ(ReadBytes(dir.file("second.dat")), OldBytes);
    EXPECT_EQ(NamesIn(dir.path()), (std::set<std::string>{"3001.dat", "second.dat"}));
}

// A backup that cannot be made stops the save with one message: the backup's path and the
// system's reason in words.
TEST_F(SaveFaults, ABackupThatCannotBeMadeSaysWhyInWords)
{
    for (const auto& [error, words] :
         {std::pair{EACCES, "permission denied"}, std::pair{EROFS, "read-only file system"}}) {
        failNext = "linkat";
        failErrno = error;
        ReplaceOptions options;
        options.backupPath = backup;
        try {
            ReplaceFileSafely(path, {NewBytes}, options);
            ADD_FAILURE() << "saved";
        } catch (const QmError& failure) {
            EXPECT_EQ(failure.description(), "cannot make the backup " + backup + ": " + words);
        }
        EXPECT_EQ(ReadBytes(path), OldBytes);
        EXPECT_EQ(NamesIn(dir.path()), std::set<std::string>{"3001.dat"});
    }
}

TEST_F(SaveFaults, ABackupThatCannotBeASecondNameIsACopy)
{
    failNext = "linkat";
    failErrno = EPERM; // as on file systems without hard links
    ReplaceOptions options;
    options.backupPath = backup;
    ReplaceFileSafely(path, {NewBytes}, options);
    EXPECT_EQ(ReadBytes(backup), OldBytes);
    EXPECT_EQ(ReadBytes(path), NewBytes);
    EXPECT_EQ(StatOf(backup).st_nlink, 1u);
}

// File systems without unnamed temporary files (NFS, SMB, vfat) refuse them with EOPNOTSUPP: the
// save goes on with a named temporary file, which it removes.
TEST_F(SaveFaults, WithoutUnnamedFilesANamedTemporaryFileIsUsed)
{
    failNext = "openat O_TMPFILE";
    failErrno = EOPNOTSUPP;
    ReplaceFileSafely(path, {NewBytes});
    EXPECT_EQ(ReadBytes(path), NewBytes);
    EXPECT_EQ(NamesIn(dir.path()), std::set<std::string>{"3001.dat"});
}

// Root gives the new file any owner; when the system refuses that, a colleague's file in a shared
// group is rewritten in place and stays the colleague's, whatever the group.
TEST_F(SaveFaults, AFileWhoseOwnerTheNewFileCannotHaveKeepsIt)
{
    if (::geteuid() != 0)
        GTEST_SKIP() << "needs root to give the file another owner";
    ASSERT_EQ(::chown(path.c_str(), 12345, ::getegid()), 0);
    const auto inode = StatOf(path).st_ino;
    failNext = "fchown";
    failErrno = EPERM;
    ReplaceFileSafely(path, {NewBytes});
    EXPECT_EQ(ReadBytes(path), NewBytes);
    EXPECT_EQ(StatOf(path).st_uid, 12345u);
    EXPECT_EQ(StatOf(path).st_ino, inode);
}

// Reading a file needs about three times its size: a file larger than a third of memory is
// refused before it is read.
TEST_F(SaveFaults, AFileLargerThanAThirdOfMemoryIsRefused)
{
    const auto page = ::sysconf(_SC_PAGESIZE);
    physicalPages = 30;
    const auto large = dir.write("large.dat", std::string(static_cast<std::size_t>(page) * 12, 'x'));
    const auto small = dir.write("small.dat", std::string(static_cast<std::size_t>(page) * 8, 'x'));
    EXPECT_EQ(ErrorNumberOf([&] { FileBytes bytes(large); }), 7);
    EXPECT_EQ(ErrorNumberOf([&] { FileBytes bytes(small); }), 0);
    // The files that the threads of a run hold at once count together.
    MemoryClaims claims;
    const auto size = static_cast<std::size_t>(page) * 8;
    {
        const auto first = claims.claim(size);
        EXPECT_EQ(ErrorNumberOf([&] { claims.claim(size); }), 7);
    }
    EXPECT_EQ(ErrorNumberOf([&] { claims.claim(size); }), 0);
    physicalPages = 0;
}

} // namespace
