// SPDX-License-Identifier: MIT
// Where quillmark-cli's findings, JSON texts and diffs end up: the forms editors, CI and patch read.
#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <nlohmann/json.hpp>
#include <regex>
#include <set>

#include "CliRun.h"
#include "TempDir.h"

namespace fs = std::filesystem;

namespace {

// A header the composer lays out anew (a blank line after the licence, none before the body), a
// comment holding an LF, which editors show as two lines, and a needless zero after a blank line.
const std::string Part = "0 Brick 2 x 4\r\n0 Name: 3001.dat\r\n0 Author: Sam Sample [ssample]\r\n"
                         "0 !LDRAW_ORG Part UPDATE 2024-01\r\n"
                         "0 !LICENSE Redistributable under CCAL version 2.0 : see CAreadme.txt\r\n"
                         "0 BFC CERTIFY CCW\r\n0 // made\nby 100% hand\r\n\r\n"
                         "3 16 0 0 0 1 0 0 0 1.50 0\r\n";

// The line of text on which what starts, as an editor counts lines.
std::size_t editorLineOf(const std::string& text, const std::string& what)
{
    const auto before = text.substr(0, text.find(what));
    return static_cast<std::size_t>(std::count(before.begin(), before.end(), '\n')) + 1;
}

CliRun checkIn(const TempDir& dir, const std::vector<std::string>& args)
{
    return RunCliInChild(args, [&dir] { fs::current_path(dir.path()); });
}

TEST(CliFormats, TextFindingsNameTheLineOnDiskAndJsonTheSame)
{
    TempDir dir;
    const auto path = dir.write("3001.dat", Part);
    const auto text = RunCliWith({"check", "--tracker", "--quiet", path});
    const auto expect = [&](std::size_t line, const std::string& rest) {
        EXPECT_TRUE(std::regex_search(text.out, std::regex(path + ":" + std::to_string(line) + ":\\d+: " + rest)))
            << rest << " on line " << line << " in\n"
            << text.out;
    };
    expect(editorLineOf(Part, "0 !LICENSE"), R"(error: The licence "Redistributable.*\[license\.approved\])");
    expect(editorLineOf(Part, "by 100%"), R"(error: Not a valid LDraw line: "by 100% hand" \[line\.invalid\])");
    expect(editorLineOf(Part, "3 16"),
           R"(error: The number "1\.50" ends in a needless zero\. \[numbers\.trailingzeros\])");
    const auto json = nlohmann::json::parse(RunCliWith({"check", "--tracker", "--json", path}).out);
    for (const auto& finding : json["tracker"]) {
        const auto line = finding.contains("line") ? std::to_string(finding["line"].get<int>()) : "1";
        const auto level = finding["level"].get<std::string>(), id = finding["id"].get<std::string>();
        EXPECT_TRUE(
            std::regex_search(text.out, std::regex(path + ":" + line + ":\\d+: " + level + ": .* \\[" + id + "\\]")))
            << finding.dump();
    }
    const auto refused = RunCliWith({"check", "--quiet", dir.write("b.dat", "0 Brick\r\n\r\n0 BFC CERTIFY\r\n")});
    EXPECT_NE(refused.out.find("b.dat:1:1: error: You need to mention the Author! [save.author]\n"), std::string::npos)
        << "no author line: the file as a whole, on line 1: " << refused.out;
    const auto escaped = RunCliWith({"check", "--tracker", "--quiet", dir.write("c.dat", "0 A\x1b[2J\r\n1 x\r\n")});
    EXPECT_EQ(escaped.out.find('\x1b'), std::string::npos) << escaped.out;
}

TEST(CliFormats, SarifHasWhatTheFormatRequiresAndStablePrints)
{
    TempDir dir;
    fs::create_directory(dir.path() / "my parts");
    dir.write("my parts/3001.dat", Part);
    dir.write("my parts/b.dat", "0 Brick\r\n");
    const auto run = checkIn(dir, {"check", "--tracker", "--format", "sarif", "-j", "2", "my parts"});
    EXPECT_EQ(run.status, 1);
    const auto log = nlohmann::json::parse(run.out);
    EXPECT_EQ(log["version"], "2.1.0");
    ASSERT_EQ(log["runs"].size(), 1u);
    const auto& driver = log["runs"][0]["tool"]["driver"];
    for (const auto* property : {"name", "version", "informationUri"})
        EXPECT_TRUE(driver[property].is_string()) << property;
    std::set<std::string> ruleIds, usedIds, prints;
    for (const auto& rule : driver["rules"])
        EXPECT_TRUE(ruleIds.insert(rule["id"].get<std::string>()).second) << "one rule per id";
    const auto& results = log["runs"][0]["results"];
    for (const auto& result : results) {
        usedIds.insert(result["ruleId"].get<std::string>());
        EXPECT_TRUE(std::set<std::string>({"error", "warning", "note"}).contains(result["level"].get<std::string>()));
        EXPECT_TRUE(result["message"]["text"].is_string());
        const auto& location = result["locations"][0]["physicalLocation"];
        EXPECT_TRUE(std::regex_match(location["artifactLocation"]["uri"].get<std::string>(),
                                     std::regex("my%20parts/(3001|b)\\.dat")));
        if (location.contains("region")) {
            EXPECT_GE(location["region"]["startLine"].get<int>(), 1);
        }
        for (const auto& [key, print] : result["partialFingerprints"].items())
            prints.insert(key + print.get<std::string>());
    }
    EXPECT_TRUE(std::includes(ruleIds.begin(), ruleIds.end(), usedIds.begin(), usedIds.end()));
    EXPECT_TRUE(usedIds.contains("save.license") && usedIds.contains("numbers.trailingzeros"));
    EXPECT_EQ(prints.size(), results.size()) << "each result its own print";
    const auto again = checkIn(dir, {"check", "--tracker", "--format", "sarif", "-j", "1", "my parts"});
    EXPECT_EQ(again.out, run.out) << "the same log, prints included";
}

TEST(CliFormats, GithubAnnotationsAreEscapedAsWorkflowCommands)
{
    TempDir dir;
    dir.write("a,b:c.dat", Part);
    const auto run = checkIn(dir, {"check", "--tracker", "--format", "github", "a,b:c.dat"});
    const auto expect = [&](const std::string& what, const std::string& rest) {
        EXPECT_TRUE(std::regex_search(
            run.out, std::regex("::error file=a%2Cb%3Ac\\.dat,line=" + std::to_string(editorLineOf(Part, what)) +
                                ",col=\\d+," + rest)))
            << rest << " in\n"
            << run.out;
    };
    expect("by 100%", R"(title=line\.invalid::Not a valid LDraw line: "by 100%25 hand"\n)");
    expect("0 !LICENSE", R"(title=license\.approved::)");
}

// The window shows a file that is valid UTF-8 as UTF-8 and any other as ISO-8859-1: JSON too.
TEST(CliFormats, JsonGivesTheHeaderTextsInTheFilesOwnEncoding)
{
    TempDir dir;
    const auto header = [](const std::string& name) { return "0 Brick\r\n0 Author: Jens Br" + name + "hl [jb]\r\n"; };
    const auto utf8 = dir.write("u.dat", header("\xc3\xbc")), latin1 = dir.write("l.dat", header("\xfc"));
    const auto fields = RunCliWith({"fields", utf8, latin1});
    std::istringstream lines(fields.out);
    for (std::string line; std::getline(lines, line);)
        EXPECT_EQ(nlohmann::json::parse(line)["AuthorRealName"], "Jens Br\u00fchl") << line;
    for (const auto& path : {utf8, latin1}) {
        const auto edit = nlohmann::json::parse(RunCliWith({"edit", "--json", "--description", "B", path}).out);
        EXPECT_NE(edit["new_header"].get<std::string>().find("Jens Br\u00fchl [jb]"), std::string::npos) << path;
    }
}

// Oddly named copies of real parts, named through "..", a link and twice: patch -p1 applies the
// dry run's diff to copies, which then hold what the edit writes, byte for byte.
TEST(CliFormats, TheDryRunPrintsOnlyADiffThatPatchAppliesWhateverTheNames)
{
    TempDir dir;
    fs::create_directories(dir.path() / "lib/sub");
    const std::vector<std::string> names = {"a b.dat",   "sub/t\tx.dat", "sub/n\nl.dat", "sub/+++ p.dat",
                                            " lead.dat", "q\"\\.dat",    "x.dat"};
    std::error_code missing;
    for (const auto& name : names)
        if (!fs::copy_file(QUILLMARK_CORPUS_DIR "/parts/104.dat", dir.file("lib/" + name), missing))
            GTEST_SKIP() << "no corpus folder beside the project";
        else
            fs::permissions(dir.file("lib/" + name), fs::perms::owner_write, fs::perm_options::add);
    dir.write("lib/refused.dat", "0 Brick\r\n");
    fs::create_symlink("x.dat", dir.path() / "lib/link.dat");
    fs::copy(dir.path() / "lib", dir.path() / "copy", fs::copy_options::recursive | fs::copy_options::copy_symlinks);
    const auto inLib = [&dir] { fs::current_path(dir.path() / "lib"); };
    const std::vector<std::string> edit = {"edit", "--description", "Antenna 6H", "--no-backup",
                                           ".",    "sub/../x.dat",  "link.dat"};
    auto dryRun = edit;
    dryRun.push_back("--dry-run");
    const auto dry = RunCliInChild(dryRun, inLib);
    EXPECT_EQ(dry.status, 1) << dry.err;
    EXPECT_TRUE(std::regex_search(dry.out, std::regex("^--- ")) &&
                !std::regex_search(dry.out, std::regex("\n[^-+@ \\\\]")))
        << "a diff and only a diff:\n"
        << dry.out;
    EXPECT_NE(dry.err.find("skipped ./refused.dat"), std::string::npos) << dry.err;
    dir.write("edits.diff", dry.out);
    ASSERT_EQ(std::system(("cd '" + dir.file("copy") + "' && patch -s -p1 <../edits.diff").c_str()), 0);
    EXPECT_EQ(RunCliInChild(edit, inLib).status, 1);
    for (const auto& name : names)
        EXPECT_TRUE(ReadBytes(dir.file("copy/" + name)) == ReadBytes(dir.file("lib/" + name))) << name;
    const auto outside = dir.write("outside.dat", ReadBytes(dir.file("copy/x.dat")));
    const auto far = RunCliInChild({"edit", "--description", "Y", "--dry-run", outside}, inLib);
    EXPECT_EQ(far.out.find("--- " + outside + "\n+++ " + outside + "\n"), 0u) << far.out;
    EXPECT_NE(far.err.find("cannot apply it"), std::string::npos);
}

} // namespace
