// SPDX-License-Identifier: MIT
// quillmark-cli save killed at each file-changing call in turn (by the preloaded KillPoints) on
// each road a save can take, cut off from its reader, or sent Ctrl+C.
#include <gtest/gtest.h>

#include <csignal>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

#include "CliFiles.h"
#include "ConsoleDialogs.h"
#include "NewFile.h"
#include "Processes.h"
#include "TempDir.h"

namespace fs = std::filesystem;

namespace {

// Blank lines that a save drops: the new text is shorter than the old, so that a rewrite in place
// stopped before the file is cut to its new length would leave the old tail behind.
const std::string OldPart = "0 Brick\r\n0 Name: a.dat\r\n0 Author: Sam Sample [ssample]\r\n0 !LDRAW_ORG Part\r\n"
                            "0 !LICENSE L\r\n\r\n\r\n\r\n0 BFC CERTIFY CCW\r\n\r\n\r\n"
                            "1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat\r\n";
const char* const KillCalls[] = {"write",    "fsync",     "link",   "linkat",  "rename",
                                 "renameat", "ftruncate", "unlink", "unlinkat"};

struct Road {
    const char* name;
    bool hardLinked = false;   // a second name: rewritten in place
    bool foreignOwner = false; // another user's group-writable file: rewritten in place
    // No new files in the folder: rewritten in place, no backup, with the copy of the old bytes in
    // a folder of the user's own below his home. The user nobody has no home: his save is refused
    // before it writes.
    bool noWriteFolder = false;
    bool asNobody() const { return foreignOwner || noWriteFolder; }
};
const Road Roads[] = {
    {"rename"}, {"hard link", true}, {"foreign owner", false, true}, {"no-write folder", false, false, true}};

// The program and the kill points where the user nobody can run them, whatever folder the build
// is in.
class ProgramCopy {
public:
    ProgramCopy()
    {
        fs::permissions(dir_.path(), fs::perms(0755));
        fs::copy_file(QUILLMARK_CLI, cli());
        fs::copy_file(QUILLMARK_KILL_POINTS, killPoints());
    }
    std::string cli() const { return dir_.file("quillmark-cli"); }
    std::string killPoints() const { return dir_.file("kill-points.so"); }

private:
    TempDir dir_;
};

const ProgramCopy& program()
{
    static const ProgramCopy copy;
    return copy;
}

// Replaces the child by quillmark-cli with args; standard error goes to errPath.
void execCli(std::vector<std::string> args, const std::string& errPath = "/dev/null")
{
    args.insert(args.begin(), program().cli());
    ::dup2(::open(errPath.c_str(), O_WRONLY | O_CREAT, 0600), STDERR_FILENO);
    std::vector<char*> argv;
    for (auto& arg : args)
        argv.push_back(arg.data());
    argv.push_back(nullptr);
    ::execv(argv[0], argv.data());
    ::_exit(127);
}

// Saves a fresh copy of the part on road, killed at the count-th call of call, opens it again, and
// says what it holds then: "old", "new", or what went wrong. Empty when the
// save ran to its end as it should.
std::string killAt(const Road& road, const std::string& call, int count, const std::string& newBytes)
{
    TempDir dir;
    fs::permissions(dir.path(), road.noWriteFolder ? fs::perms(0755) : fs::perms::all);
    const auto path = dir.write("a.dat", OldPart);
    std::set<std::string> names{"a.dat"};
    if (road.hardLinked && names.insert("second.dat").second)
        fs::create_hard_link(path, dir.file("second.dat"));
    ::chmod(path.c_str(), road.foreignOwner ? 0664 : 0666);
    EXPECT_TRUE(!road.foreignOwner || ::chown(path.c_str(), 12345, 65534) == 0);
    const int status = WaitFor(StartChild(road.asNobody(), [&] {
        ::setenv("LD_PRELOAD", program().killPoints().c_str(), 1);
        ::setenv("ASAN_OPTIONS", "verify_asan_link_order=0", 1);
        ::setenv("QUILLMARK_KILL_CALL", call.c_str(), 1);
        ::setenv("QUILLMARK_KILL_AT", std::to_string(count).c_str(), 1);
        ::dup2(::open("/dev/null", O_WRONLY), STDOUT_FILENO);
        execCli(road.noWriteFolder ? std::vector<std::string>{"save", "-j", "1", "--no-backup", path}
                                   : std::vector<std::string>{"save", "-j", "1", path});
    }));
    // As the user who saved: another user's copy is never applied.
    const int opened = WaitFor(StartChild(road.asNobody(), [&] {
        std::ostringstream err;
        ConsoleDialogs dialogs(err);
        const ReplaceOptions writing;
        int status = 0;
        RunReads reads;
        ReadForCli(OpenPart::openPath(path), path, dialogs, err, &writing, status, reads);
        ::_exit(err.str().find("restored " + path + " from an interrupted save") == std::string::npos ? 0 : 1);
    }));
    const auto bytes = ReadBytes(path);
    std::string outcome = bytes == OldPart ? "old" : bytes == newBytes ? "new" : "TORN";
    if (WEXITSTATUS(opened) == 1)
        outcome += " (restored)";
    for (const auto& name : NamesIn(dir.path())) {
        if (names.contains(name))
            continue;
        if (!name.starts_with("a_Backup_") || ReadBytes(dir.file(name)) != OldPart)
            outcome += ", left " + name;
        else if (fs::equivalent(dir.file(name), path))
            outcome += ", backup is a second name of the part"; // which the next save must not write into
    }
    if (road.foreignOwner && StatOf(path).st_uid != 12345)
        outcome += ", owner changed";
    if (!WIFSIGNALED(status) || WTERMSIG(status) != SIGKILL)
        return outcome == "new" ? "" : "unstopped, " + outcome;
    return outcome;
}

TEST(KilledCliSave, EveryKillPointOnEveryRoadLeavesOldOrNewBytesAfterTheNextOpen)
{
    if (::geteuid() != 0)
        GTEST_SKIP() << "needs root to run the saves of other users";
    program();         // copied before any child needs it
    TempDir reference; // what a complete save writes
    const auto referencePath = reference.write("a.dat", OldPart);
    ASSERT_EQ(WaitFor(StartChild(false, [&] { execCli({"save", "--no-backup", referencePath}); })), 0);
    const auto newBytes = ReadBytes(referencePath);
    std::ostringstream table;
    int restored = 0; // torn parts that the next open wrote the old bytes back to, and said so
    for (const auto& road : Roads) {
        for (const std::string call : KillCalls) {
            for (int count = 1; count < 20; ++count) {
                const auto outcome = killAt(road, call, count, newBytes);
                if (outcome.empty())
                    break;
                table << road.name << " | " << call << " #" << count << " | " << outcome << "\n";
                restored += outcome == "old (restored)";
                const bool refusedWithoutHome = road.noWriteFolder && outcome == "unstopped, old";
                EXPECT_TRUE(outcome == "old" || outcome == "new" || outcome == "old (restored)" ||
                            outcome == "old, backup is a second name of the part" || refusedWithoutHome)
                    << road.name << ", killed at " << call << " #" << count << ": " << outcome;
                if (outcome.starts_with("unstopped"))
                    break;
            }
        }
    }
    EXPECT_GT(restored, 0);
    if (const char* out = std::getenv("QUILLMARK_KILL_TABLE"))
        std::ofstream(out) << table.str();
}

// A reader that goes away (quillmark-cli save ... | head -1) or Ctrl+C ends the run between files
// with exit status 3, said on standard error; the files begun are finished.
TEST(StoppedCliSave, EndsBetweenFiles)
{
    program(); // copied before any child needs it
    for (const bool interrupted : {false, true}) {
        TempDir dir;
        std::vector<std::string> args{"save", "-j", "2"};
        for (int i = 0; i < 400; ++i)
            args.push_back(dir.write(std::to_string(i) + ".dat", OldPart));
        int ends[2];
        ASSERT_EQ(::pipe(ends), 0);
        ::close(ends[0]); // nobody reads
        const pid_t child = StartChild(false, [&] {
            ::dup2(interrupted ? ::open("/dev/null", O_WRONLY) : ends[1], STDOUT_FILENO);
            execCli(args, dir.file("err.txt"));
        });
        ::close(ends[1]);
        while (interrupted && ReadBytes(dir.file("0.dat")) == OldPart) // the run has begun
            std::this_thread::sleep_for(std::chrono::milliseconds(1));
        ::kill(child, interrupted ? SIGINT : 0);
        const int status = WaitFor(child);
        ASSERT_TRUE(WIFEXITED(status)) << "ended by signal " << WTERMSIG(status);
        EXPECT_EQ(WEXITSTATUS(status), 3);
        EXPECT_NE(ReadBytes(dir.file("err.txt"))
                      .find(interrupted ? "interrupted; the run ends here" : "standard output closed (EPIPE)"),
                  std::string::npos);
        EXPECT_EQ(ReadBytes(dir.file("399.dat")), OldPart) << "the run went on";
    }
}

} // namespace
