// check and save over folders and many files: which files, in which order, on how many threads,
// and what the summary and the progress line say.
#include <gtest/gtest.h>

#include <fcntl.h>
#include <filesystem>
#include <pty.h>
#include <sys/wait.h>
#include <unistd.h>

#include "CliRun.h"
#include "Corpus.h"
#include "TempDir.h"

namespace fs = std::filesystem;

namespace {

const std::string GoodPart = "0 Brick\r\n0 Author: Sam Sample [ssample]\r\n0 !LDRAW_ORG Part\r\n0 !LICENSE L\r\n"
                             "0 BFC CERTIFY CCW\r\n1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat\r\n";
const std::string NoBfcLongPart = "0 " + std::string(70, 'x') +
                                  "\r\n0 Author: Sam\r\n0 !LDRAW_ORG Part\r\n"
                                  "0 !LICENSE L\r\n0 WRITE hello\r\n";

TEST(CliBatch, FoldersGivePartFilesOfAnyCaseInPathOrderWithoutFollowingLinkedFolders)
{
    TempDir dir;
    fs::create_directories(dir.path() / "lib/parts/s");
    fs::create_directories(dir.path() / "elsewhere");
    const auto lib = (dir.path() / "lib").string();
    TempDir::writeTo(lib + "/parts/s/b.DAT", GoodPart);
    TempDir::writeTo(lib + "/parts/a.dat", GoodPart);
    TempDir::writeTo(lib + "/parts/readme.txt", GoodPart);
    TempDir::writeTo(lib + "/c.Dat", GoodPart);
    TempDir::writeTo(dir.file("elsewhere/linked.dat"), GoodPart);
    fs::create_directory_symlink(dir.path() / "elsewhere", lib + "/link");
    const auto single = dir.write("z.txt", GoodPart);
    const auto run = RunCliWith({"check", "--quiet", single, lib});
    EXPECT_EQ(run.out,
              single + ": ok\n" + lib + "/c.Dat: ok\n" + lib + "/parts/a.dat: ok\n" + lib + "/parts/s/b.DAT: ok\n");
}

TEST(CliBatch, SummaryCountsEachFindingAndTheLengthLimitCanBeLifted)
{
    TempDir dir;
    dir.write("good.dat", GoodPart);
    dir.write("bad1.dat", NoBfcLongPart);
    dir.write("bad2.dat", NoBfcLongPart);
    const auto run = RunCliWith({"check", dir.path().string(), dir.file("missing.dat")});
    EXPECT_EQ(run.status, 2);
    const auto summary = run.err.substr(run.err.find("4 files"));
    EXPECT_EQ(summary, "4 files, 2 refused, 2 without user name, 1 unreadable\n"
                       "  refused: Length of the part description is limited to 64 character!: 2\n"
                       "  refused: You need to set the BFC type!: 2\n"
                       "  fix-up offered: 0 WRITE lines in the body: 2\n");
    const auto lifted = RunCliWith({"check", "--quiet", "--no-length-limit", dir.file("bad1.dat")});
    EXPECT_EQ(lifted.out, dir.file("bad1.dat") + ": refused: You need to set the BFC type!\n" + dir.file("bad1.dat") +
                              ": missing user name\n" + dir.file("bad1.dat") +
                              ": fix-up offered: 0 WRITE lines in the body\n");
    EXPECT_EQ(lifted.err, "");
}

TEST(CliBatch, ManyThreadsWriteWhatOneThreadWrites)
{
    const auto files = CorpusPartFiles();
    if (files.empty())
        GTEST_SKIP() << "no corpus folder beside the project";
    const auto one = RunCliWith({"check", "--json", "-j", "1", QUILLMARK_CORPUS_DIR});
    const auto many = RunCliWith({"check", "--json", "-j", "7", QUILLMARK_CORPUS_DIR});
    EXPECT_EQ(one.out, many.out);
    EXPECT_EQ(one.err, many.err);
    EXPECT_EQ(std::count(one.out.begin(), one.out.end(), '\n'), static_cast<long>(files.size()));
}

// Runs the quillmark-cli program on a folder with standard error on a pseudo-terminal or a pipe,
// and returns what standard error showed.
std::string standardErrorOfCheck(const std::string& folder, bool onTerminal)
{
    int reader = -1, writer = -1;
    if (onTerminal) {
        if (::openpty(&reader, &writer, nullptr, nullptr, nullptr) != 0)
            return "no pseudo-terminal";
    } else {
        int ends[2];
        if (::pipe(ends) != 0)
            return "no pipe";
        reader = ends[0];
        writer = ends[1];
    }
    const pid_t child = ::fork();
    if (child == 0) {
        ::dup2(writer, STDERR_FILENO);
        ::dup2(::open("/dev/null", O_WRONLY), STDOUT_FILENO);
        ::execl(QUILLMARK_CLI, "quillmark-cli", "check", folder.c_str(), static_cast<char*>(nullptr));
        ::_exit(127);
    }
    ::close(writer);
    std::string shown;
    char buffer[4096];
    for (ssize_t got; (got = ::read(reader, buffer, sizeof buffer)) > 0;)
        shown.append(buffer, static_cast<std::size_t>(got));
    ::close(reader);
    ::waitpid(child, nullptr, 0);
    return shown;
}

TEST(CliBatch, AProgressLineOnlyOnATerminal)
{
    TempDir dir;
    for (int i = 0; i < 3; ++i)
        dir.write(std::to_string(i) + ".dat", GoodPart);
    const auto onTerminal = standardErrorOfCheck(dir.path().string(), true);
    EXPECT_NE(onTerminal.find("\r\033[K3 of 3 files, "), std::string::npos) << onTerminal;
    EXPECT_NE(onTerminal.find("\r\033[K3 files, 0 refused"), std::string::npos) << onTerminal;
    const auto onPipe = standardErrorOfCheck(dir.path().string(), false);
    EXPECT_EQ(onPipe, "3 files, 0 refused, 0 without user name, 0 unreadable\n");
}

} // namespace
