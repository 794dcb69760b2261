// SPDX-License-Identifier: MIT
// Reading files that are not what a part file should be: the program must answer at once and
// never hang, crash or run out of memory.
#include <gtest/gtest.h>

#include <fcntl.h>
#include <filesystem>
#include <sys/stat.h>
#include <unistd.h>

#include "ErrorNumber.h"
#include "PartFile.h"
#include "TempDir.h"

namespace {

// Ends the test program if a read hangs, so that a hang fails instead of blocking the suite.
class Watchdog {
public:
    Watchdog() { ::alarm(20); }
    ~Watchdog() { ::alarm(0); }
    Watchdog(const Watchdog&) = delete;
    Watchdog& operator=(const Watchdog&) = delete;
};

int readError(const std::string& path)
{
    return ErrorNumberOf([&path] { const FileBytes bytes(path); });
}

TEST(ReadingFiles, OnlyRegularFilesAreRead)
{
    const Watchdog watchdog;
    TempDir dir;
    const auto fifo = dir.file("fifo.dat");
    ASSERT_EQ(::mkfifo(fifo.c_str(), 0600), 0);
    EXPECT_EQ(readError(fifo), 75);
    EXPECT_EQ(readError(dir.path().string()), 75);
    EXPECT_EQ(readError("/dev/zero"), 75);
    EXPECT_EQ(readError(dir.file("missing.dat")), 53);
    EXPECT_EQ(FileBytes(dir.write("part.dat", "0 x\r\n")).view(), "0 x\r\n");
}

TEST(ReadingFiles, FilesLongerOrShorterThanTheyClaimYieldWhatIsThere)
{
    const Watchdog watchdog;
    // The system's own files claim a size they do not have, as a file that another program
    // lengthens or shortens while it is read.
    const FileBytes grown("/proc/self/status"); // claims 0 bytes
    EXPECT_NE(grown.view().find("Name:"), std::string_view::npos);
    const std::string shrunkPath = "/sys/kernel/mm/transparent_hugepage/enabled"; // claims 4096
    if (!std::filesystem::exists(shrunkPath))
        GTEST_SKIP() << "no " << shrunkPath << " on this system";
    const FileBytes shrunk(shrunkPath);
    EXPECT_LT(shrunk.view().size(), 4096u);
    EXPECT_NE(shrunk.view().find("never"), std::string_view::npos);
}

} // namespace
