// SPDX-License-Identifier: MIT
// quillmark-cli's commands: what each prints, writes and exits with.
#include <gtest/gtest.h>

#include <algorithm>
#include <fcntl.h>
#include <filesystem>
#include <functional>
#include <grp.h>
#include <map>
#include <nlohmann/json.hpp>
#include <pty.h>
#include <set>
#include <sstream>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include "CliRun.h"
#include "Corpus.h"
#include "TempDir.h"
#include "TrackerFixes.h"
#include "UnifiedDiff.h"

namespace fs = std::filesystem;

namespace {

const std::string GoodPart = "0 Brick\r\n0 Author: Sam Sample [ssample]\r\n0 !LDRAW_ORG Part\r\n0 !LICENSE L\r\n"
                             "0 BFC CERTIFY CCW\r\n1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat\r\n";
const std::string NoAuthorPart = "0 Brick\r\n0 COLOR 4 red\r\n0 ROTATION CENTER 0 0 0\r\n1 16 a.dat\r\n";
const std::string NoUserPart = "0 " + std::string(70, 'x') +
                               "\r\n0 Author: Sam\r\n0 !LDRAW_ORG Part\r\n"
                               "0 !LICENSE L\r\n0 BFC CERTIFY CCW\r\n0 WRITE hello\r\n";
const std::string SamplePart = "0 Brick\t2 x 4\r\n0 Name: 3001.dat\r\n0 Author: Sam Sample [ssample]\r\n"
                               "0 BFC CERTIFY CCW\r\n0 !KEYWORDS a, b\r\n0 Caf\xe9\r\n"
                               "1 16 0 0 0 1 0 0 0 1 0 0 0 1 3001s01.dat\r\n";

// In a child run as root, becomes the user nobody, for whom permissions count.
void becomeUnprivileged()
{
    if (::geteuid() == 0 && (::setgroups(0, nullptr) != 0 || ::setresgid(65534, 65534, 65534) != 0 ||
                             ::setresuid(65534, 65534, 65534) != 0))
        ::_exit(125);
}

// Lets the child open no more than allowed descriptors beside those it has open.
void allowDescriptors(int allowed)
{
    const int lowestFree = ::dup(STDIN_FILENO);
    ::close(lowestFree);
    const rlimit limit{rlim_t(lowestFree + allowed), rlim_t(lowestFree + allowed)};
    ::setrlimit(RLIMIT_NOFILE, &limit);
}

TEST(CliFields, OneJsonLinePerFileAndTheUnreadableNamedOnStandardError)
{
    TempDir dir;
    const auto path = dir.write("3001.dat", SamplePart);
    const auto run = RunCliWith({"fields", path, dir.file("missing.dat")});
    EXPECT_EQ(run.status, 2);
    ASSERT_EQ(lineCount(run.out), 1u);
    const auto json = nlohmann::json::parse(run.out);
    EXPECT_EQ(json["FilePath"], path);
    EXPECT_EQ(json["FileFolder"], dir.path().string());
    EXPECT_EQ(json["PartDescription"], "Brick2 x 4");
    EXPECT_EQ(json["Keywords"], nlohmann::json::array({"a, b"}));
    EXPECT_EQ(json["Body"], "0 Caf\u00e9\r\n1 16 0 0 0 1 0 0 0 1 0 0 0 1 3001s01.dat");
    EXPECT_NE(run.err.find("A TAB character was found"), std::string::npos);
    EXPECT_NE(run.err.find("cannot read " + dir.file("missing.dat")), std::string::npos);
    const auto binary = RunCliWith({"fields", dir.write("picture.dat", std::string("\x89PNG\r\n\0\0", 8))});
    EXPECT_EQ(binary.status, 2);
    EXPECT_EQ(binary.out, "");
    EXPECT_EQ(binary.err, "quillmark-cli: " + dir.file("picture.dat") + " is not an LDraw text file.\n");
}

// A byte order mark before the first line is kept there, and the header after it is read.
TEST(CliPrint, WritesTheComposedHeaderTheBodyAndOneCrLf)
{
    TempDir dir;
    const auto run = RunCliWith({"print", dir.write("3001.dat", SamplePart)});
    EXPECT_EQ(run.status, 0);
    EXPECT_EQ(run.out, "0 Brick2 x 4\r\n0 Name: 3001.dat\r\n0 Author: Sam Sample [ssample]\r\n\r\n"
                       "0 BFC CERTIFY CCW\r\n\r\n0 !KEYWORDS a, b\r\n\r\n"
                       "0 Caf\xe9\r\n1 16 0 0 0 1 0 0 0 1 0 0 0 1 3001s01.dat\r\n");
    const std::string mark = "\xEF\xBB\xBF";
    EXPECT_EQ(RunCliWith({"print", dir.write("bom.dat", mark + SamplePart)}).out, mark + run.out);
}

TEST(CliCheck, ListsEveryFindingInLinesOrJsonAndNeverWritesAndExitsWithTheWorst)
{
    TempDir dir;
    const auto good = dir.write("good.dat", GoodPart);
    const auto bad = dir.write("bad.dat", NoAuthorPart);
    const auto run = RunCliWith({"check", "--quiet", good, bad});
    EXPECT_EQ(run.status, 1);
    EXPECT_EQ(run.out, good + ": ok\n" + bad + ":1:1: error: You need to mention the Author! [save.author]\n" + bad +
                           ":1:1: error: You need to set the BFC type! [save.bfc]\n" + bad +
                           ":1:1: error: You need to set the License type! [save.license]\n" + bad +
                           ":1:1: error: You need to set the Part type! [save.type]\n" + bad +
                           ":1:1: warning: The author line names no user. [save.username]\n" + bad +
                           ":1:1: note: A save would offer a fix-up: 0 ROTATION lines in the body. "
                           "[save.fixup.rotation]\n" +
                           bad +
                           ":2:9: note: A save would offer a fix-up: COLOR lines in the header. [save.fixup.color]\n");
    const auto json = nlohmann::json::parse(RunCliWith({"check", "--json", bad}).out);
    EXPECT_EQ(json["FilePath"], bad);
    EXPECT_EQ(json["refusals"][0], "You need to mention the Author!\r\nSaving the file is not possible");
    EXPECT_EQ(json["missing_username"], true);
    EXPECT_EQ(json["fixups"],
              (nlohmann::json{{"certify_invertnext", false}, {"rotation", true}, {"write", false}, {"color", true}}));
    EXPECT_EQ(ReadBytes(bad), NoAuthorPart);
    EXPECT_EQ(NamesIn(dir.path()), (std::set<std::string>{"good.dat", "bad.dat"}));
    EXPECT_EQ(RunCliWith({"check", "--quiet", bad, good}).status, 1) << "the worst file's status, not the last one's";
    EXPECT_EQ(RunCliWith({"check", "--quiet", "--tracker", good}).status, 1) << "no name line, an unknown licence";

    const auto folder = dir.path().string(); // names shown without control characters, JSON paths as UTF-8
    EXPECT_EQ(RunCliWith({"check", "--quiet", dir.write("a\nb\x1b.dat", GoodPart)}).out,
              folder + "/a\\nb\\x1b.dat: ok\n");
    const auto utf8 = dir.write("\xc3\xa9t\xc3\xa9.dat", GoodPart);
    const auto latin1 = dir.write("\xe9t\xe9.dat", GoodPart);
    EXPECT_EQ(nlohmann::json::parse(RunCliWith({"check", "--json", utf8}).out)["FilePath"], utf8);
    EXPECT_EQ(nlohmann::json::parse(RunCliWith({"check", "--json", latin1}).out)["FilePath"], utf8);
}

TEST(CliSave, SavesGoodFilesWithBackupSkipsRefusedOnesAndReportsFailures)
{
    TempDir dir;
    const auto good = dir.write("good.dat", GoodPart);
    const auto bad = dir.write("bad.dat", NoAuthorPart);
    const auto noDot = dir.write("noext", GoodPart); // no backup name without "."
    const auto printed = RunCliWith({"print", good}).out;
    const auto run = RunCliWith({"save", "--quiet", good, bad, noDot, dir.file("missing.dat")});
    EXPECT_EQ(run.status, 3);
    EXPECT_EQ(run.err, "quillmark-cli: cannot read " + dir.file("missing.dat") + ": File not found\n")
        << "quiet, nothing else";
    EXPECT_EQ(ReadBytes(good), printed);
    EXPECT_EQ(ReadBytes(bad), NoAuthorPart);
    EXPECT_EQ(ReadBytes(noDot), GoodPart);
    EXPECT_NE(run.out.find("saved " + good + " (backup: " + dir.path().string() + "/good_Backup_"), std::string::npos);
    EXPECT_NE(run.out.find("skipped " + bad + ": You need to mention the Author!\n"), std::string::npos);
    EXPECT_NE(run.out.find("failed " + noDot + ": Error 5 "), std::string::npos);
    EXPECT_EQ(NamesIn(dir.path()).size(), 4u);
}

// " parts/a.dat" is not parts/a.dat.
TEST(CliSave, APathIsTakenByteForByte)
{
    TempDir dir;
    fs::create_directory(dir.path() / " parts");
    fs::create_directory(dir.path() / "parts");
    const auto named = dir.write(" parts/a.dat", GoodPart);
    dir.write("parts/a.dat", GoodPart);
    const auto run = RunCliInChild({"save", " parts/a.dat"}, [&dir] { fs::current_path(dir.path()); });
    EXPECT_EQ(run.status, 0) << run.err;
    EXPECT_NE(ReadBytes(named), GoodPart);
    EXPECT_EQ(NamesIn(dir.path() / " parts").size(), 2u) << "the backup beside the file";
    EXPECT_EQ(NamesIn(dir.path() / "parts"), std::set<std::string>{"a.dat"});
    EXPECT_EQ(ReadBytes(dir.file("parts/a.dat")), GoodPart);
}

TEST(CliSave, MissingUserNameFixesAndLongDescriptionsEachNeedTheirFlag)
{
    TempDir dir;
    const auto part = dir.write("nouser.dat", NoUserPart);
    EXPECT_EQ(RunCliWith({"save", "--no-backup", "--allow-missing-username", part}).status, 1) << "too long";
    EXPECT_EQ(RunCliWith({"save", "--no-backup", "--no-length-limit", part}).status, 1) << "no user name";
    EXPECT_EQ(ReadBytes(part), NoUserPart);
    EXPECT_EQ(RunCliWith({"save", "--no-backup", "--no-length-limit", "--allow-missing-username", part}).status, 0);
    EXPECT_NE(ReadBytes(part).find("0 WRITE hello"), std::string::npos);
    RunCliWith({"save", "--no-backup", "--no-length-limit", "--allow-missing-username", "--fix", part});
    EXPECT_NE(ReadBytes(part).find("0 hello"), std::string::npos);
    EXPECT_EQ(NamesIn(dir.path()).size(), 1u);
}

TEST(CliBatch, FoldersGivePartFilesOfAnyCaseInPathOrderWithoutFollowingLinkedFolders)
{
    TempDir dir;
    fs::create_directories(dir.path() / "lib/parts/s");
    fs::create_directories(dir.path() / "elsewhere");
    const auto lib = (dir.path() / "lib").string();
    for (const auto* name : {"/parts/s/b.DAT", "/parts/a.dat", "/parts/readme.txt", "/c.Dat"})
        TempDir::writeTo(lib + name, GoodPart);
    TempDir::writeTo(dir.file("elsewhere/linked.dat"), GoodPart);
    fs::create_directory_symlink(dir.path() / "elsewhere", lib + "/link");
    const auto outside = dir.write("elsewhere/outside.dat", GoodPart);
    fs::create_symlink(outside, lib + "/parts/out.dat");
    const auto single = dir.write("z.txt", GoodPart);
    const auto run = RunCliWith({"check", single, lib});
    EXPECT_EQ(run.out,
              single + ": ok\n" + lib + "/c.Dat: ok\n" + lib + "/parts/a.dat: ok\n" + lib + "/parts/s/b.DAT: ok\n");
    EXPECT_EQ(run.err, "4 files, 0 refused, 0 without user name, 0 unreadable, 2 links skipped\n");
    EXPECT_EQ(RunCliWith({"save", lib}).status, 0);
    EXPECT_EQ(ReadBytes(outside), GoodPart);
    EXPECT_EQ(NamesIn(dir.path() / "elsewhere"), (std::set<std::string>{"linked.dat", "outside.dat"}));
}

TEST(CliBatch, BackupsAreNotWalkedAndAFileAlreadySavedIsNotWrittenAgain)
{
    TempDir dir;
    const auto folder = dir.path().string();
    const auto part = dir.write("a.dat", GoodPart);
    ASSERT_EQ(RunCliWith({"save", folder}).status, 0);
    const auto names = NamesIn(dir.path());
    const auto backup = dir.file(*names.rbegin()); // after "a.dat"
    const auto again = RunCliWith({"save", "--no-backup", folder});
    EXPECT_EQ(again.out, "unchanged " + part + "\n");
    EXPECT_EQ(again.err, "1 file, 0 refused, 0 without user name, 0 unreadable, 1 backup skipped; "
                         "0 saved, 1 unchanged, 0 skipped, 0 failed\n");
    EXPECT_EQ(RunCliWith({"save", folder}).status, 0);
    EXPECT_EQ(NamesIn(dir.path()), names) << "no backup of a file left as it was";
    EXPECT_EQ(ReadBytes(backup), GoodPart);
    EXPECT_EQ(RunCliWith({"check", backup}).out, backup + ": ok\n") << "named, a backup is a file like any";
}

// Run by a user who may not read one folder, with one descriptor to spare, then none. A first run
// in each child lets the sanitizers make the checks for which they take descriptors themselves.
TEST(CliBatch, AWalkHoldsTwoDescriptorsHoweverDeepAndReportsWhatItCannotRead)
{
    TempDir dir;
    fs::permissions(dir.path(), fs::perms::owner_all | fs::perms::others_read | fs::perms::others_exec);
    const auto folder = dir.path().string();
    std::string deep = folder;
    for (int level = 0; level < 40; ++level)
        deep += "/d";
    fs::create_directories(deep);
    const auto part = dir.write(deep + "/a.dat", GoodPart);
    const auto locked = dir.path() / "locked";
    fs::create_directory(locked);
    dir.write("locked/b.dat", GoodPart);
    fs::permissions(locked, fs::perms::none);
    const auto run = RunCliInChild({"check", "-j", "1", folder}, [&folder] {
        RunCliWith({"check", folder});
        becomeUnprivileged();
        allowDescriptors(2); // a folder, and its subfolder while the walk steps down into it
    });
    EXPECT_EQ(run.status, 2);
    EXPECT_EQ(run.out, part + ": ok\n");
    EXPECT_EQ(run.err, "quillmark-cli: cannot read folder " + locked.string() +
                           ": Permission denied\n1 file, 0 refused, 0 without user name, 1 unreadable\n");
    const auto none = RunCliInChild({"check", folder}, [&folder] {
        RunCliWith({"check", folder});
        allowDescriptors(0);
    });
    fs::permissions(locked, fs::perms::owner_all);
    EXPECT_EQ(none.status, 2);
    EXPECT_NE(none.err.find("cannot read folder " + folder + ": Too many open files\n"), std::string::npos);
}

TEST(CliBatch, JobsOutsideOneTo1024AreRefusedAndThreadsThatCannotStartAreNotNeeded)
{
    TempDir dir;
    fs::permissions(dir.path(), fs::perms::owner_all | fs::perms::others_read | fs::perms::others_exec);
    for (const auto* name : {"1.dat", "2.dat", "3.dat"})
        dir.write(name, GoodPart);
    for (const auto* jobs : {"0", "-1", "5000"}) {
        const auto run = RunCliWith({"check", "-j", jobs, dir.path().string()});
        EXPECT_EQ(run.status, 2) << jobs;
        EXPECT_NE(run.err.find("--jobs: Value " + std::string(jobs) + " not in range 1 to 1024"), std::string::npos);
    }
    const auto run = RunCliInChild({"check", "-j", "4", dir.path().string()}, [] {
        becomeUnprivileged();
        const rlimit noNewThreads{1, 1};
        ::setrlimit(RLIMIT_NPROC, &noNewThreads);
    });
    EXPECT_EQ(run.status, 0) << run.err;
    EXPECT_EQ(lineCount(run.out), 3u);
}

TEST(CliBatch, SummaryCountsEachFinding)
{
    TempDir dir;
    dir.write("good.dat", GoodPart);
    dir.write("bad1.dat", NoUserPart);
    dir.write("bad2.dat", NoUserPart);
    const auto run = RunCliWith({"check", dir.path().string(), dir.file("missing.dat")});
    EXPECT_EQ(run.status, 2);
    EXPECT_EQ(run.err.substr(run.err.find("4 files")),
              "4 files, 2 refused, 2 without user name, 1 unreadable\n"
              "  refused (2): Length of the part description is limited to 64 characters!\n"
              "  fix-up offered (2): 0 WRITE lines in the body\n");
}

TEST(CliTracker, ColoursComeFromTheLibrarysLDConfig)
{
    TempDir dir;
    std::filesystem::create_directories(dir.path() / "library/parts");
    dir.write("library/LDConfig.ldr", "0 !COLOUR Main_Colour CODE 16 VALUE #FFFF80 EDGE #333333\r\n");
    const auto bad = dir.write("library/parts/3001.dat",
                               "0 Brick  2 x  4\r\n0 Name: 3001.dat\r\n0 Author: Sam Sample [ssample]\r\n"
                               "0 !LDRAW_ORG Part UPDATE 2024-01\r\n"
                               "0 !LICENSE Licensed under CC BY 4.0 : see CAreadme.txt\r\n0 BFC CERTIFY CCW\r\n"
                               "3 16 0 0 0 1 0 0 0 1 0\r\n3 4 0 0 0 1 0 0 0 1 0\r\n");
    const auto text = RunCliWith({"check", "--tracker", "--quiet", bad});
    EXPECT_EQ(text.status, 1);
    EXPECT_EQ(text.out, bad + ":8:1: error: Colour 4 is not defined in LDConfig.ldr. [line.invalidcolor]\n");
    const auto malformed = dir.write("LDConfig.ldr", "0 !COLOUR Red CODE 4\r\n");
    const auto builtIn = RunCliWith({"check", "--tracker", "--quiet", "--ldconfig", malformed, bad, bad});
    EXPECT_EQ(builtIn.out.find("invalidcolor"), std::string::npos) << "the built-in list has 4";
    EXPECT_EQ(std::count(builtIn.err.begin(), builtIn.err.end(), '\n'), 1) << builtIn.err;
    EXPECT_NE(builtIn.err.find(malformed), std::string::npos);
}

// Hunks as diff -u makes them: three lines of context, near changes in one hunk, an insertion at
// the start, a last line without a line end.
TEST(UnifiedDiff, AsDiffMakesIt)
{
    std::string before, after = "new\n";
    for (int line = 1; line <= 30; ++line) {
        const auto text = "line " + std::to_string(line) + (line % 10 == 0 ? "\r\n" : "\n");
        before += text;
        after += line == 5 || line == 11 || line == 25 ? "" : line == 30 ? "line 30" : text;
    }
    TempDir dir;
    const auto command = "diff -u '" + dir.write("a", before) + "' '" + dir.write("b", after) + "' | tail -n +3 >'" +
                         dir.file("diff") + "'";
    ASSERT_EQ(std::system(command.c_str()), 0);
    EXPECT_EQ(UnifiedDiff(before, after, "a/p.dat", "b/p.dat"),
              "--- a/p.dat\n+++ b/p.dat\n" + ReadBytes(dir.file("diff")));
    EXPECT_EQ(UnifiedDiff(before, before, "a/p.dat", "b/p.dat"), "");
    EXPECT_EQ(UnifiedDiff("", "x\n", "a/p.dat", "b/p.dat"), "--- a/p.dat\n+++ b/p.dat\n@@ -0,0 +1 @@\n+x\n");
}

// Real files: one refused (no user name), two edited. The dry run's diff, applied by patch to a
// copy, gives what the edit writes; an edit that changes nothing more writes nothing.
TEST(CliEdit, TheDryRunsDiffIsWhatTheEditWritesAndUnknownListValuesAreRefusedFirst)
{
    TempDir dir;
    const std::vector<std::string> names = {"104.dat", "391.dat", "s/2895s01.dat"};
    for (const auto* copy : {"lib/s", "copy/lib/s"})
        fs::create_directories(dir.path() / copy);
    std::error_code missing;
    for (const auto& name : names)
        for (const auto* copy : {"lib/", "copy/lib/"})
            if (!fs::copy_file(QUILLMARK_CORPUS_DIR "/parts/" + name, dir.file(copy + name), missing))
                GTEST_SKIP() << "no corpus folder beside the project";
            else
                fs::permissions(dir.file(copy + name), fs::perms::owner_write, fs::perm_options::add);
    std::vector<std::string> edit = {"edit",   "--license", "current", "--name-from-path", "--add-history",
                                     "Edited", "--as",      "jtester", "--no-backup",      "lib"};
    const auto inDir = [&dir] { fs::current_path(dir.path()); };
    edit.push_back("--dry-run");
    const auto dry = RunCliInChild(edit, inDir);
    edit.pop_back();
    EXPECT_EQ(dry.status, 1);
    EXPECT_NE(dry.err.find("; 0 saved, 2 would be saved, 0 unchanged, 1 skipped, 0 failed\n"), std::string::npos);
    EXPECT_EQ(dry.out.find("--- a/lib/104.dat\n+++ b/lib/104.dat\n@@ -2,10 +2,12 @@\n 0 Name: 104.dat\r\n"), 0u);
    EXPECT_EQ(ReadBytes(dir.file("lib/104.dat")), ReadBytes(dir.file("copy/lib/104.dat")));
    TempDir::writeTo(dir.file("edits.diff"), dry.out);
    ASSERT_EQ(std::system(("cd '" + dir.file("copy") + "' && patch -s -p1 <../edits.diff").c_str()), 0);
    EXPECT_EQ(RunCliInChild(edit, inDir).status, 1);
    for (const auto& name : names)
        EXPECT_TRUE(ReadBytes(dir.file("lib/" + name)) == ReadBytes(dir.file("copy/lib/" + name))) << name;
    EXPECT_NE(ReadBytes(dir.file("lib/104.dat")).find("0 !HISTORY 2"), std::string::npos);
    const auto again = RunCliInChild({"edit", "--license", "current", "--name-from-path", "--no-backup", "lib"}, inDir);
    EXPECT_EQ(again.out, "unchanged lib/104.dat\nskipped lib/391.dat: no user name set\nunchanged lib/s/2895s01.dat\n");
    const auto unknown = RunCliWith({"edit", "--type", "Brik", "--no-backup", dir.file("lib")});
    EXPECT_EQ(unknown.status, 2);
    EXPECT_EQ(unknown.out, "");
    EXPECT_EQ(unknown.err.find("quillmark-cli: --type Brik is not in the list: Part, Subpart, "), 0u);
    const auto before = ReadBytes(dir.file("lib/104.dat"));
    const auto json =
        nlohmann::json::parse(RunCliWith({"edit", "--json", "--description", "X", dir.file("lib/104.dat")}).out);
    EXPECT_EQ(json["new_header"].get<std::string>().rfind("0 X\r\n0 Name: 104.dat\r\n", 0), 0u);
    EXPECT_EQ(json["old_header"].get<std::string>().rfind("0 Antenna  6H\r\n", 0), 0u);
    EXPECT_EQ(ReadBytes(dir.file("lib/104.dat")), before);
}

// The subparts of the corpus: real files in hundreds, checked with the Parts Tracker's rules too.
TEST(CliBatch, ManyThreadsWriteWhatOneThreadWrites)
{
    const std::string subparts = QUILLMARK_CORPUS_DIR "/parts/s";
    const auto files = CorpusPartFiles();
    const auto inSubparts = std::count_if(files.begin(), files.end(), [&subparts](const fs::path& file) {
        return file.string().rfind(subparts + "/", 0) == 0;
    });
    if (inSubparts == 0)
        GTEST_SKIP() << "no corpus folder beside the project";
    const auto one = RunCliWith({"check", "--json", "--tracker", "-j", "1", subparts});
    const auto many = RunCliWith({"check", "--json", "--tracker", "-j", "7", subparts});
    EXPECT_EQ(one.out, many.out);
    EXPECT_EQ(one.err, many.err);
    EXPECT_EQ(lineCount(one.out), static_cast<std::size_t>(inSubparts));
}

// What standard error showed when the quillmark-cli program checked folder with it on a
// pseudo-terminal or a pipe.
std::string standardErrorOfCheck(const std::string& folder, bool onTerminal)
{
    int ends[2];
    if (onTerminal ? ::openpty(&ends[0], &ends[1], nullptr, nullptr, nullptr) != 0 : ::pipe(ends) != 0)
        return "no terminal or pipe";
    const pid_t child = ::fork();
    if (child == 0) {
        ::dup2(ends[1], STDERR_FILENO);
        ::dup2(::open("/dev/null", O_WRONLY), STDOUT_FILENO);
        ::execl(QUILLMARK_CLI, "quillmark-cli", "check", folder.c_str(), static_cast<char*>(nullptr));
        ::_exit(127);
    }
    ::close(ends[1]);
    auto shown = readAll(ends[0]);
    ::waitpid(child, nullptr, 0);
    return shown;
}

TEST(CliBatch, AProgressLineOnlyOnATerminal)
{
    TempDir dir;
    for (const auto* name : {"1.dat", "2.dat", "3.dat"})
        dir.write(name, GoodPart);
    const auto onTerminal = standardErrorOfCheck(dir.path().string(), true);
    EXPECT_NE(onTerminal.find("\r\033[K3 of 3 files, "), std::string::npos) << onTerminal;
    EXPECT_NE(onTerminal.find("\r\033[K3 files, 0 refused"), std::string::npos) << onTerminal;
    EXPECT_EQ(standardErrorOfCheck(dir.path().string(), false),
              "3 files, 0 refused, 0 without user name, 0 unreadable\n");
}

} // namespace

namespace {

// Per file, the ids of check --tracker --json over a folder.
std::map<std::string, std::set<std::string>> trackerIds(const std::string& output)
{
    std::map<std::string, std::set<std::string>> ids;
    std::istringstream lines(output);
    for (std::string line; std::getline(lines, line);) {
        const auto json = nlohmann::json::parse(line);
        auto& of = ids[json["FilePath"].get<std::string>()];
        for (const auto& finding : json["tracker"])
            of.insert(finding["id"].get<std::string>());
    }
    return ids;
}

// A third of the real subparts, copied twice: the dry run's diff applied to one copy gives the bytes that fix
// writes into the other; afterwards the check finds in each file written no fixed id but those fix
// says it left, and no id the file did not have; a second fix writes nothing.
TEST(CliFix, AFolderIsFixedOnceAndTheDryRunsDiffIsWhatFixWrites)
{
    TempDir dir;
    for (const auto* copy : {"lib/s", "copy/lib/s"}) {
        fs::create_directories(dir.path() / copy);
        std::error_code missing;
        int file = 0;
        for (const auto& entry : fs::directory_iterator(QUILLMARK_CORPUS_DIR "/parts/s", missing)) {
            if (file++ % 3 != 0)
                continue; // a third of them is variety enough
            fs::copy_file(entry.path(), dir.path() / copy / entry.path().filename());
            fs::permissions(dir.path() / copy / entry.path().filename(), fs::perms::owner_write, fs::perm_options::add);
        }
        if (missing)
            GTEST_SKIP() << "no corpus folder beside the project";
    }
    const auto inDir = [&dir] { fs::current_path(dir.path()); };
    const auto before = trackerIds(RunCliInChild({"check", "--tracker", "--json", "--quiet", "lib"}, inDir).out);
    const std::vector<std::string> fix = {"fix", "lib"};
    auto dryRun = fix;
    dryRun.push_back("--dry-run");
    TempDir::writeTo(dir.file("fixes.diff"), RunCliInChild(dryRun, inDir).out);
    ASSERT_EQ(std::system(("cd '" + dir.file("copy") + "' && patch -s -p1 <../fixes.diff").c_str()), 0);
    const auto fixed = RunCliInChild(fix, inDir);
    for (const auto& entry : fs::directory_iterator(dir.path() / "lib/s"))
        EXPECT_TRUE(ReadBytes(entry.path()) == ReadBytes(dir.path() / "copy/lib/s" / entry.path().filename()))
            << entry.path();
    const auto after = trackerIds(RunCliInChild({"check", "--tracker", "--json", "--quiet", "lib"}, inDir).out);
    int cleared = 0;
    for (const auto& [path, ids] : after) {
        if (fixed.out.find("left " + path + ": ") != std::string::npos)
            continue; // a finding stops the Tracker's other rules: not written
        for (const auto& id : ids) {
            EXPECT_TRUE(before.at(path).contains(id)) << path << " has " << id << " only after the fix";
            if (DefaultFixIds().contains(id)) {
                EXPECT_NE(fixed.out.find(path + ": left " + id + ": "), std::string::npos) << path << " " << id;
            }
        }
        cleared += static_cast<int>(before.at(path).size() - ids.size());
    }
    EXPECT_GT(cleared, 100) << "the licence alone is old in every file";
    const auto again = RunCliInChild(fix, inDir);
    EXPECT_EQ(again.out.find("saved "), std::string::npos) << again.out;
    EXPECT_NE(again.err.find(" 0 saved,"), std::string::npos) << again.err;
}

} // namespace
