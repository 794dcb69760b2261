// SPDX-License-Identifier: MIT
// quillmark-cli among files that others share, lock and change: what a command that only reads
// leaves behind (nothing), and what a command that writes does when the file changes under it,
// is locked, or lies in a folder that is swapped for a link.
#include <gtest/gtest.h>

#include <algorithm>
#include <csignal>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <map>
#include <sstream>
#include <sys/file.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

#include "CliFiles.h"
#include "CliRun.h"
#include "Composer.h"
#include "ConsoleDialogs.h"
#include "FileSave.h"
#include "FixedClock.h"
#include "KeepFile.h"
#include "PartFile.h"
#include "PartFileList.h"
#include "TempDir.h"

namespace fs = std::filesystem;

namespace {

const std::string Part = "0 Brick\r\n0 Name: a.dat\r\n0 Author: Sam Sample [ssample]\r\n0 !LDRAW_ORG Part\r\n"
                         "0 !LICENSE L\r\n0 BFC CERTIFY CCW\r\n1 16 0 0 0 1 0 0 0 1 0 0 0 1 b.dat\r\n";

// Every entry of a folder with its bytes and inode.
std::map<std::string, std::pair<std::string, ino_t>> snapshot(const fs::path& folder)
{
    std::map<std::string, std::pair<std::string, ino_t>> entries;
    for (const auto& name : NamesIn(folder))
        entries[name] = {ReadBytes((folder / name).string()), StatOf((folder / name).string()).st_ino};
    return entries;
}

// Starts quillmark-cli with args; its standard output and error go to files in dir.
pid_t startCli(const std::vector<std::string>& args, const TempDir& dir)
{
    const pid_t child = ::fork();
    if (child == 0) {
        ::dup2(::open(dir.file("out.txt").c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0600), STDOUT_FILENO);
        ::dup2(::open(dir.file("err.txt").c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0600), STDERR_FILENO);
        std::vector<char*> argv{const_cast<char*>(QUILLMARK_CLI)};
        for (const auto& arg : args)
            argv.push_back(const_cast<char*>(arg.c_str()));
        argv.push_back(nullptr);
        ::execv(argv[0], argv.data());
        ::_exit(127);
    }
    return child;
}

TEST(ReadOnlyCommands, WriteNothingAndReportATornPartAsItsRestoreWouldLeaveIt)
{
    TempDir dir;
    const auto path = dir.write("a.dat", Part);
    const auto clean = RunCliWith({"print", path});
    { // a rewrite in place, killed halfway
        KeepFile keep(*OpenPart::openPath(path), Part, {"0 New\r\n" + Part}, "");
        keep.keep();
    }
    TempDir::writeTo(path, "0 New\r\n" + Part.substr(7));
    dir.write(".quillmark-save-99999-notes.txt", "a user's notes");
    dir.write(".quillmark-save-0123456789abcdef", "what a killed save left");
    const auto before = snapshot(dir.path());
    for (const auto& args :
         std::vector<std::vector<std::string>>{{"check", dir.path().string()},
                                               {"fields", path},
                                               {"print", path},
                                               {"edit", "--author", "Ann [ann]", "--json", path},
                                               {"edit", "--author", "Ann [ann]", "--dry-run", path}}) {
        const auto run = RunCliWith(args);
        EXPECT_EQ(snapshot(dir.path()), before) << args[0] << " " << args[1];
        EXPECT_NE(run.err.find(path + ": an interrupted save will be restored by the next save"), std::string::npos)
            << args[0] << " " << args[1];
        if (args[0] == "print") {
            EXPECT_EQ(run.out, clean.out);
        }
    }
    const auto saved = RunCliWith({"save", "--no-backup", dir.path().string()});
    EXPECT_NE(saved.err.find("restored " + path + " from an interrupted save"), std::string::npos) << saved.err;
    EXPECT_EQ(NamesIn(dir.path()), (std::set<std::string>{"a.dat", ".quillmark-save-99999-notes.txt"}));
}

// The part changed after its save was killed: the save leaves it and the copy alone, and fails.
TEST(WritingCommands, APartThatChangedSinceItsSaveWasKilledIsLeftAndFails)
{
    TempDir dir;
    const auto path = dir.write("a.dat", Part);
    {
        KeepFile keep(*OpenPart::openPath(path), Part, {"0 New\r\n" + Part}, "");
        keep.keep();
    }
    TempDir::writeTo(path, "0 The user's own\r\n");
    const auto before = snapshot(dir.path());
    const auto run = RunCliWith({"save", "--no-backup", path});
    EXPECT_EQ(run.status, 3);
    EXPECT_EQ(run.out, "failed " + path + ": an interrupted save was not restored\n");
    EXPECT_EQ(run.err.find(path + ": " + path), std::string::npos) << run.err;
    EXPECT_NE(run.err.find(path + ": an interrupted save was not restored because the file changed since"),
              std::string::npos);
    EXPECT_EQ(snapshot(dir.path()), before);
}

// Another user's copy beside the part is named once in a run that writes, and the save goes on.
TEST(WritingCommands, AnotherUsersCopyIsNamedOnceAndTheSaveGoesOn)
{
    if (::geteuid() != 0)
        GTEST_SKIP() << "needs root to give a copy another owner";
    TempDir dir;
    const auto path = dir.write("a.dat", Part);
    {
        KeepFile keep(*OpenPart::openPath(path), "0 his bytes\r\n", {Part + "0 // more\r\n"}, "");
        keep.keep();
    }
    const auto copy = NamesIn(dir.path()).begin()->starts_with(".quillmark-keep-") ? *NamesIn(dir.path()).begin()
                                                                                   : *NamesIn(dir.path()).rbegin();
    ASSERT_EQ(::chown(dir.file(copy).c_str(), 12345, 12345), 0);
    const auto run = RunCliWith({"edit", "--author", "Ann [ann]", "--no-backup", path});
    EXPECT_EQ(run.status, 0) << run.out << run.err;
    const std::string notice =
        path + ": a copy left by another user's interrupted save is at " + dir.file(copy) +
        "; it was not applied; the file stays as that save left it until that user saves it again";
    EXPECT_NE(run.err.find(notice), std::string::npos) << run.err;
    EXPECT_EQ(run.err.find(notice), run.err.rfind(notice)) << "named once";
    EXPECT_NE(ReadBytes(path).find("Author: Ann [ann]"), std::string::npos);
}

// Another program appends to the part between the read and the save: the save fails, the append
// stays.
TEST(WritingCommands, AChangeBetweenReadAndSaveFailsTheSave)
{
    TempDir dir;
    const auto path = dir.write("a.dat", Part);
    std::ostringstream err;
    ConsoleDialogs dialogs(err, [](const MessageBox&) { return Answer::No; });
    const ReplaceOptions run;
    int status = 0;
    RunReads reads;
    auto header = ReadForCli(OpenPart::openPath(path), path, dialogs, err, &run, status, reads);
    ASSERT_TRUE(header);
    header->PartDescription = "Brick 2 x 4";
    std::ofstream(path, std::ios::app) << "1 16 0 0 0 1 0 0 0 1 0 0 0 1 c.dat\r\n";
    const FixedClock clock;
    EXPECT_FALSE(FileSave(*header, ComposeHeader(*header), false, clock, dialogs, run).saved);
    EXPECT_EQ(dialogs.lastTitle(), ChangedOnDiskTitle);
    EXPECT_EQ(ReadBytes(path), Part + "1 16 0 0 0 1 0 0 0 1 0 0 0 1 c.dat\r\n");
}

// A part that another program holds locked: the save waits for it, says so, and SIGTERM ends the
// wait at once; the run ends as interrupted.
TEST(WritingCommands, ALockedPartIsWaitedForUntilAnInterrupt)
{
    TempDir dir;
    const auto path = dir.write("a.dat", Part);
    const FileDescriptor holder(::open(path.c_str(), O_RDONLY));
    ASSERT_EQ(::flock(holder.get(), LOCK_EX), 0);
    const pid_t cli = startCli({"edit", "--author", "Ann [ann]", path}, dir);
    // The run gives up waiting by itself after 10 s; this waits no longer than that.
    for (int tries = 0; tries < 1500 && ReadBytes(dir.file("err.txt")).find("waiting for") == std::string::npos;
         ++tries)
        std::this_thread::sleep_for(std::chrono::milliseconds(10));
    ::kill(cli, SIGTERM);
    int status = 0;
    ::waitpid(cli, &status, 0);
    ASSERT_TRUE(WIFEXITED(status));
    EXPECT_EQ(WEXITSTATUS(status), 3);
    EXPECT_EQ(ReadBytes(dir.file("out.txt")), "failed " + path + ": interrupted\n");
    EXPECT_NE(ReadBytes(dir.file("err.txt")).find("waiting for " + path + ": another program holds it\n"),
              std::string::npos);
    EXPECT_EQ(ReadBytes(path), Part);
}

// Another user swaps a subfolder for a link to the victim's folder after the walk saw it: the
// files found there are never opened through the link.
TEST(FolderRuns, AFolderSwappedForALinkIsNeverEntered)
{
    TempDir team, victims;
    fs::create_directories(team.path() / "aaa");
    fs::create_directories(team.path() / "zzz");
    team.write("aaa/1.dat", Part);
    team.write("zzz/3001.dat", Part);
    const auto victim = victims.write("3001.dat", "the victim's part");
    const auto found = ExpandPartFiles({team.path().string()});
    ASSERT_EQ(found.files.size(), 2u);
    fs::rename(team.path() / "zzz", team.path() / "elsewhere");
    fs::create_directory_symlink(victims.path(), team.path() / "zzz");
    EXPECT_EQ(ReadBytes(OpenEntry(found.files[0])->path()), Part);
    try {
        EXPECT_EQ(FileBytes(*OpenEntry(found.files[1])).view(), Part) << "the folder the walk saw";
    } catch (const QmError&) {
        // refused is as good
    }
    RunCliWith({"edit", "--author", "Ann [ann]", "--no-backup", team.path().string()});
    EXPECT_EQ(ReadBytes(victim), "the victim's part");
    EXPECT_EQ(NamesIn(victims.path()), std::set<std::string>{"3001.dat"});
}

// A folder that another user replaces by a folder of his own after the walk saw it: no file of
// his is taken for the one the walk found there, whether the walk still holds the folder or, past
// the number of folders it holds, finds it again along its trail.
TEST(FolderRuns, AFolderReplacedAfterTheWalkIsNeverEntered)
{
    for (const int folders : {2, 300}) {
        TempDir team;
        for (int i = 0; i < folders; ++i) {
            fs::create_directories(team.path() / ("f" + std::to_string(i)));
            team.write("f" + std::to_string(i) + "/3001.dat", Part);
        }
        const auto found = ExpandPartFiles({team.path().string()});
        ASSERT_EQ(found.files.size(), static_cast<std::size_t>(folders));
        const auto notHeld = std::find_if(found.files.begin(), found.files.end(),
                                          [](const PartFileEntry& entry) { return !entry.folder->held; });
        const auto& entry = notHeld != found.files.end() ? *notHeld : found.files.back();
        ASSERT_EQ(folders > 2, notHeld != found.files.end());
        fs::rename(team.path() / entry.folder->name, team.path() / "moved");
        fs::create_directories(team.path() / entry.folder->name);
        team.write(entry.folder->name + "/3001.dat", "0 his own part\r\n");
        try {
            EXPECT_EQ(FileBytes(*OpenEntry(entry)).view(), Part) << folders;
        } catch (const QmError&) {
            // refused is as good as the folder the walk saw
        }
    }
}

// One file named many times in one run: each name's turn comes after the save of the one
// before, and reads what that save wrote, never the file it replaced.
TEST(WritingCommands, EveryNameOfOneFileReadsWhatTheSaveBeforeWrote)
{
    TempDir dir;
    const auto path = dir.write("a.dat", Part);
    std::vector<std::string> args{"edit", "--author", "Ann [ann]", "--no-backup", "-j", "2"};
    for (int name = 0; name < 20; ++name)
        args.push_back(name % 2 == 0 ? path : dir.path().string() + "/./a.dat");
    const auto run = RunCliWith(args);
    EXPECT_EQ(run.status, 0) << run.out << run.err;
    EXPECT_EQ(run.out.find("failed"), std::string::npos) << run.out;
}

// The copy a killed save kept of a file that is gone is named once and never written anywhere.
TEST(FolderRuns, ACopyWhoseFileIsGoneIsReportedAndLeftAlone)
{
    TempDir dir;
    dir.write("a.dat", Part);
    struct stat folder {};
    ::stat(dir.path().c_str(), &folder);
    const auto orphan = ".quillmark-keep-" + std::to_string(folder.st_dev) + "-4000000000";
    dir.write(orphan, "quillmark-keep 2 ...");
    const auto run = RunCliWith({"save", "--no-backup", dir.path().string()});
    EXPECT_NE(run.err.find(dir.file(orphan) + ": the copy an interrupted save kept of a file that is gone"),
              std::string::npos)
        << run.err;
    EXPECT_EQ(ReadBytes(dir.file(orphan)), "quillmark-keep 2 ...");
}

// A binary file is refused on its first bytes, never read whole.
TEST(ReadingFiles, ABinaryFileIsRefusedBeforeItIsRead)
{
    TempDir dir;
    const auto path = dir.file("s.dat");
    const FileDescriptor sparse(::open(path.c_str(), O_WRONLY | O_CREAT, 0600));
    ASSERT_EQ(::ftruncate(sparse.get(), off_t{2} << 30), 0); // 2 GiB of zeros that take no disk
    const pid_t cli = startCli({"check", path}, dir);
    int status = 0;
    struct rusage usage {};
    ::wait4(cli, &status, 0, &usage);
    EXPECT_EQ(WEXITSTATUS(status), 2);
    EXPECT_LT(usage.ru_maxrss, 100 * 1024) << "KiB at the peak";
}

// A part whose text head is followed by holes holds NUL bytes: it is refused at the first one past
// the head, before the rest is read, and never written, so no hole becomes a disk block.
TEST(ReadingFiles, ASparsePartWithATextHeadIsRefusedAtItsFirstHole)
{
    TempDir dir;
    std::string head = Part;
    while (head.size() < 80 * 1024)
        head += "0 // a comment line that fills the head of the part\r\n";
    const auto path = dir.write("s.dat", head);
    ASSERT_EQ(::truncate(path.c_str(), off_t{1} << 30), 0); // 1 GiB, the rest holes
    const auto blocks = StatOf(path).st_blocks;
    for (const auto& args : std::vector<std::vector<std::string>>{
             {"check", path}, {"edit", "--author", "Ann [ann]", "--no-backup", path}}) {
        const pid_t cli = startCli(args, dir);
        int status = 0;
        struct rusage usage {};
        ::wait4(cli, &status, 0, &usage);
        EXPECT_EQ(WEXITSTATUS(status), 2) << args[0];
        EXPECT_LT(usage.ru_maxrss, 100 * 1024) << args[0] << ": KiB at the peak";
        EXPECT_NE(ReadBytes(dir.file("err.txt")).find(path + " is not an LDraw text file."), std::string::npos)
            << ReadBytes(dir.file("err.txt"));
    }
    EXPECT_EQ(StatOf(path).st_blocks, blocks);
    EXPECT_EQ(StatOf(path).st_size, off_t{1} << 30);
}

} // namespace
