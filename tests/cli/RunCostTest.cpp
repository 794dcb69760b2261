// SPDX-License-Identifier: MIT
// What a folder run costs per file in system calls: a command that only reads opens each file in
// its folder, reads it and closes it; the rest (the user's home, his keep folder, the memory
// figures) is found once per run.
#include <gtest/gtest.h>

#include <cstdlib>
#include <fstream>
#include <sstream>
#include <sys/wait.h>
#include <unistd.h>

#include "TempDir.h"

namespace {

const std::string Part = "0 Brick\r\n0 Name: a.dat\r\n0 Author: Sam Sample [ssample]\r\n0 !LDRAW_ORG Part\r\n"
                         "0 !LICENSE L\r\n0 BFC CERTIFY CCW\r\n1 16 0 0 0 1 0 0 0 1 0 0 0 1 b.dat\r\n";

// The system calls of `quillmark-cli check folder` over all its threads, futex aside, as strace
// counts them; -1 when strace did not run.
long systemCallsOfCheck(const std::string& folder, const TempDir& scratch)
{
    const auto counts = scratch.file("counts.txt");
    const auto command =
        "strace -f -c -o " + counts + " " + QUILLMARK_CLI + " check --quiet " + folder + " >/dev/null 2>&1";
    if (std::system(command.c_str()) == -1)
        return -1;
    std::ifstream table(counts);
    long calls = 0;
    bool rows = false;
    for (std::string line; std::getline(table, line);) {
        if (line.starts_with("------")) {
            rows = !rows;
            continue;
        }
        std::istringstream row(line);
        std::vector<std::string> words;
        for (std::string word; row >> word;)
            words.push_back(word);
        // "% time  seconds  usecs/call  calls  [errors]  syscall"
        if (!rows || words.size() < 5 || words.back() == "futex")
            continue;
        calls += std::stol(words[3]);
    }
    return rows ? -1 : calls;
}

TEST(FolderRunCost, ACheckMakesAtMostTenSystemCallsPerFile)
{
    if (std::system("strace -V >/dev/null 2>&1") != 0)
        GTEST_SKIP() << "strace is not installed";
    TempDir scratch, few, many;
    constexpr int Few = 100, Many = 400;
    for (int i = 0; i < Many; ++i) {
        if (i < Few)
            few.write(std::to_string(i) + ".dat", Part);
        many.write(std::to_string(i) + ".dat", Part);
    }
    const auto fewCalls = systemCallsOfCheck(few.path().string(), scratch);
    const auto manyCalls = systemCallsOfCheck(many.path().string(), scratch);
    ASSERT_GT(fewCalls, 0);
    ASSERT_GT(manyCalls, 0);
    // What a run pays once falls out of the difference.
    const double perFile = static_cast<double>(manyCalls - fewCalls) / (Many - Few);
    EXPECT_LE(perFile, 10.0) << fewCalls << " calls for " << Few << " files, " << manyCalls << " for " << Many;
}

} // namespace
