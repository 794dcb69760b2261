// quillmark-cli's commands: what each prints, writes and exits with.
#include <gtest/gtest.h>

#include <algorithm>
#include <fcntl.h>
#include <filesystem>
#include <nlohmann/json.hpp>
#include <pty.h>
#include <sstream>
#include <sys/wait.h>
#include <unistd.h>

#include "CliApp.h"
#include "Corpus.h"
#include "TempDir.h"

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

struct CliRun {
    int status;
    std::string out, err;
};

// Runs quillmark-cli in this process with the given arguments.
CliRun RunCliWith(std::vector<std::string> args)
{
    args.insert(args.begin(), "quillmark-cli");
    std::vector<const char*> argv;
    for (const auto& arg : args)
        argv.push_back(arg.c_str());
    std::ostringstream out, err;
    const int status = RunCli(static_cast<int>(argv.size()), argv.data(), out, err);
    return {status, out.str(), err.str()};
}

std::size_t lineCount(const std::string& text)
{
    return static_cast<std::size_t>(std::count(text.begin(), text.end(), '\n'));
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

TEST(CliCheck, ListsEveryFindingInLinesOrJsonAndNeverWrites)
{
    TempDir dir;
    const auto good = dir.write("good.dat", GoodPart);
    const auto bad = dir.write("bad.dat", NoAuthorPart);
    const auto run = RunCliWith({"check", "--quiet", good, bad});
    EXPECT_EQ(run.status, 1);
    EXPECT_EQ(run.out, good + ": ok\n" + bad + ": refused: You need to mention the Author!\n" + bad +
                           ": refused: You need to set the BFC type!\n" + bad +
                           ": refused: You need to set the Liscense type!\n" + bad +
                           ": refused: You need to set the Part type!\n" + bad + ": missing user name\n" + bad +
                           ": fix-up offered: 0 ROTATION lines in the body\n" + bad +
                           ": fix-up offered: COLOR lines in the header\n");
    const auto json = nlohmann::json::parse(RunCliWith({"check", "--json", bad}).out);
    EXPECT_EQ(json["FilePath"], bad);
    EXPECT_EQ(json["refusals"][0], "You need to mention the Author!\r\nSaving the file is not possible");
    EXPECT_EQ(json["missing_username"], true);
    EXPECT_EQ(json["fixups"],
              (nlohmann::json{{"certify_invertnext", false}, {"rotation", true}, {"write", false}, {"color", true}}));
    EXPECT_EQ(ReadBytes(bad), NoAuthorPart);
    EXPECT_EQ(NamesIn(dir.path()), (std::set<std::string>{"good.dat", "bad.dat"}));
}

TEST(CliSave, SavesGoodFilesWithBackupSkipsRefusedOnesAndReportsFailures)
{
    TempDir dir;
    const auto good = dir.write("good.dat", GoodPart);
    const auto bad = dir.write("bad.dat", NoAuthorPart);
    const auto noDot = dir.write("noext", GoodPart); // no backup name without "."
    const auto printed = RunCliWith({"print", good}).out;
    const auto run = RunCliWith({"save", good, bad, noDot});
    EXPECT_EQ(run.status, 3);
    EXPECT_EQ(ReadBytes(good), printed);
    EXPECT_EQ(ReadBytes(bad), NoAuthorPart);
    EXPECT_EQ(ReadBytes(noDot), GoodPart);
    EXPECT_NE(run.out.find("saved " + good + " (backup: " + dir.path().string() + "/good_Backup_"), std::string::npos);
    EXPECT_NE(run.out.find("skipped " + bad + ": You need to mention the Author!\n"), std::string::npos);
    EXPECT_NE(run.out.find("failed " + noDot + ": Error 5 "), std::string::npos);
    EXPECT_EQ(NamesIn(dir.path()).size(), 4u);
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
    const auto single = dir.write("z.txt", GoodPart);
    const auto run = RunCliWith({"check", "--quiet", single, lib});
    EXPECT_EQ(run.status, 0);
    EXPECT_EQ(run.out,
              single + ": ok\n" + lib + "/c.Dat: ok\n" + lib + "/parts/a.dat: ok\n" + lib + "/parts/s/b.DAT: ok\n");
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
              "  refused: Length of the part description is limited to 64 character!: 2\n"
              "  fix-up offered: 0 WRITE lines in the body: 2\n");
}

// The line of the text that saving path would write on which text starts, counted from 1.
int savedLineOf(const std::string& path, const std::string& text)
{
    const auto saved = RunCliWith({"print", path}).out;
    return static_cast<int>(std::count(saved.begin(), saved.begin() + saved.find(text), '\n')) + 1;
}

TEST(CliTracker, LineFindingsNameTheirLineAndColoursComeFromTheLibrarysLDConfig)
{
    TempDir dir;
    std::filesystem::create_directories(dir.path() / "library/parts");
    dir.write("library/LDConfig.ldr", "0 !COLOUR Main_Colour CODE 16 VALUE #FFFF80 EDGE #333333\r\n");
    const auto bad = dir.write("library/parts/3001.dat",
                               "0 Brick  2 x  4\r\n0 Name: 3001.dat\r\n0 Author: Sam Sample [ssample]\r\n"
                               "0 !LDRAW_ORG Part UPDATE 2024-01\r\n"
                               "0 !LICENSE Licensed under CC BY 4.0 : see CAreadme.txt\r\n0 BFC CERTIFY CCW\r\n"
                               "3 16 0 0 0 1 0 0 0 1\r\n3 4 0 0 0 1 0 0 0 1 0\r\n");
    const auto invalid = savedLineOf(bad, "3 16 "), red = savedLineOf(bad, "3 4 ");
    const auto text = RunCliWith({"check", "--tracker", "--quiet", bad});
    EXPECT_EQ(text.status, 1);
    EXPECT_NE(text.out.find(bad + ": tracker error line.invalid: line " + std::to_string(invalid) + ": "),
              std::string::npos)
        << text.out;
    const auto json = nlohmann::json::parse(RunCliWith({"check", "--tracker", "--json", bad}).out);
    ASSERT_EQ(json["tracker"].size(), 2u) << json.dump();
    EXPECT_EQ(json["tracker"][0]["line"], invalid);
    EXPECT_EQ(json["tracker"][1]["id"], "line.invalidcolor");
    EXPECT_EQ(json["tracker"][1]["line"], red);
    const auto malformed = dir.write("LDConfig.ldr", "0 !COLOUR Red CODE 4\r\n");
    const auto builtIn = RunCliWith({"check", "--tracker", "--quiet", "--ldconfig", malformed, bad, bad});
    EXPECT_EQ(builtIn.out.find("invalidcolor"), std::string::npos) << "the built-in list has 4";
    EXPECT_EQ(std::count(builtIn.err.begin(), builtIn.err.end(), '\n'), 1) << builtIn.err;
    EXPECT_NE(builtIn.err.find(malformed), std::string::npos);
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
    std::string shown;
    char buffer[4096];
    for (ssize_t got; (got = ::read(ends[0], buffer, sizeof buffer)) > 0;)
        shown.append(buffer, static_cast<std::size_t>(got));
    ::close(ends[0]);
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
