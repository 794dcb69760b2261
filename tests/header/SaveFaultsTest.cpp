// Saving when the system fails one of its calls. The calls are intercepted in this test program
// alone: a call named in failNext fails once with failErrno, and every call is recorded.
#include <gtest/gtest.h>

#include <cerrno>
#include <dlfcn.h>
#include <filesystem>
#include <sys/stat.h>
#include <unistd.h>

#include "QmError.h"
#include "SafeReplace.h"
#include "TempDir.h"

namespace {

std::vector<std::string> calls;
std::string failNext;
int failErrno = EIO;

template <typename Real, typename... Args>
int intercept(const char* name, Real* real, Args... args)
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
    for (const char* step : {"fchmod", "fsync", "linkat", "close", "rename", "link"}) {
        for (const bool withBackup : {false, true}) {
            if (std::string(step) == "link" && !withBackup)
                continue; // only the backup is made by link
            failNext = step;
            failErrno = EIO;
            EXPECT_THROW(ReplaceFileSafely(path, {NewBytes}, withBackup ? std::optional(backup) : std::nullopt),
                         QmError)
                << step;
            EXPECT_EQ(ReadBytes(path), OldBytes) << step;
            EXPECT_EQ(NamesIn(dir.path()), std::set<std::string>{"3001.dat"}) << step << " " << withBackup;
        }
    }
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
