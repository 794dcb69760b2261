// Saving when the system fails one of its calls. The calls are intercepted in this test program
// alone: a call named in failNext fails once with failErrno, and every call is recorded.
#include <gtest/gtest.h>

#include <cerrno>
#include <dlfcn.h>
#include <filesystem>
#include <sys/stat.h>
#include <unistd.h>

#include "ErrorNumber.h"
#include "SafeReplace.h"
#include "TempDir.h"

namespace {

std::vector<std::string> calls;
std::string failNext;
int failErrno = EIO;

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
int close(int fd) { return intercept("close", realFunction<int(int)>("close"), fd); }
int fchmod(int fd, mode_t mode) noexcept
{
    return intercept("fchmod", realFunction<int(int, mode_t)>("fchmod"), fd, mode);
}
int rename(const char* from, const char* to) noexcept
{
    return intercept("rename", realFunction<int(const char*, const char*)>("rename"), from, to);
}
int link(const char* from, const char* to) noexcept
{
    return intercept("link", realFunction<int(const char*, const char*)>("link"), from, to);
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
            ReplaceFileSafely(path, {NewBytes}, withBackup ? std::optional(backup) : std::nullopt);
        });
    }
    TempDir dir;
    const std::string path = dir.write("3001.dat", OldBytes);
    const std::string backup = dir.file("3001_Backup.dat");
};

TEST_F(SaveFaults, TheNewTextIsOnDiskBeforeItTakesTheNameAndTheFolderAfter)
{
    calls.clear();
    ReplaceFileSafely(path, {NewBytes}, std::nullopt);
    std::vector<std::string> order;
    for (const auto& call : calls)
        if (call == "fsync" || call == "rename")
            order.push_back(call);
    EXPECT_EQ(order, (std::vector<std::string>{"fsync", "rename", "fsync"}));
    EXPECT_EQ(ReadBytes(path), NewBytes);
}

TEST_F(SaveFaults, AFailingStepKeepsTheOldFileAndLeavesNothingBehind)
{
    for (const char* step : {"write", "fchmod", "fsync", "linkat", "close", "rename", "link"}) {
        for (const bool withBackup : {false, true}) {
            if (std::string(step) == "link" && !withBackup)
                continue;                                                   // only the backup is made by link
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
    EXPECT_EQ(failureNumber("ftruncate", EROFS, false), 70);
    EXPECT_EQ(ReadBytes(dir.file("second.dat")), OldBytes);
    EXPECT_EQ(NamesIn(dir.path()), (std::set<std::string>{"3001.dat", "second.dat"}));
}

TEST_F(SaveFaults, ABackupThatCannotBeASecondNameIsACopy)
{
    failNext = "link";
    failErrno = EPERM; // as on file systems without hard links
    ReplaceFileSafely(path, {NewBytes}, backup);
    EXPECT_EQ(ReadBytes(backup), OldBytes);
    EXPECT_EQ(ReadBytes(path), NewBytes);
    struct stat info {};
    ::stat(backup.c_str(), &info);
    EXPECT_EQ(info.st_nlink, 1u);
}

} // namespace
