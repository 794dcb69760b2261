// SPDX-License-Identifier: MIT
// check as CI and editors use it: compiler-style lines in file order, rules chosen on the command
// line or by quillmark.toml, every id explained, SARIF and GitHub paths where those tools look.
#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <nlohmann/json.hpp>
#include <regex>
#include <set>
#include <sstream>

#include "CliRun.h"
#include "FileReport.h"
#include "RuleTexts.h"
#include "SaveChecks.h"
#include "TempDir.h"

namespace fs = std::filesystem;

namespace {

const std::string Header = "0 Brick  2 x  4\r\n0 Name: 3001.dat\r\n0 Author: Sam Sample [ssample]\r\n"
                           "0 !LDRAW_ORG Part UPDATE 2024-01\r\n"
                           "0 !LICENSE Licensed under CC BY 4.0 : see CAreadme.txt\r\n0 BFC CERTIFY CCW\r\n\r\n";
const std::string TrailingZero = "3 16 0 0 0 1 0 0 0 1.50 0\r\n";
const std::string LeadingZero = "3 16 01 0 0 0 0 0 1 1 0\r\n";

std::vector<std::string> linesOf(const std::string& text)
{
    std::vector<std::string> lines;
    std::istringstream in(text);
    for (std::string line; std::getline(in, line);)
        lines.push_back(line);
    return lines;
}

std::set<std::string> idsIn(const std::string& textOutput)
{
    std::set<std::string> ids;
    const std::regex id(R"(\[([a-z0-9.-]+)\]$)");
    for (const auto& line : linesOf(textOutput))
        if (std::smatch found; std::regex_search(line, found, id))
            ids.insert(found[1]);
    return ids;
}

CliRun checkIn(const fs::path& folder, const std::vector<std::string>& args)
{
    return RunCliInChild(args, [&folder] { fs::current_path(folder); });
}

// Every id a check can report: the save checks' (all of them fail on an empty record), the fix-ups'
// and the Tracker's, which its rules only take from the table (a missing one stops their tests).
TEST(Checker, ExplainsEveryIdTheProgramCanReport)
{
    HeaderData empty;
    empty.NeedsWork = true;
    empty.PartDescription = std::string(65, 'x');
    auto ids = EvaluateSaveChecks(empty).refusalIds;
    ids.emplace_back(SaveCheckIds::UserName);
    for (const auto& fixup : FixUpNames({true, true, true, true}))
        ids.emplace_back(fixup.id);
    for (const auto& rule : RuleTexts())
        ids.emplace_back(rule.id);
    ASSERT_GT(ids.size(), 50u);
    const std::regex sections("^([a-z0-9.-]+): .+\n\nChecks:\n  .+\nWhy:\n  .+\nRepair:\n  .+\nExample:\n  .+\n$");
    for (const auto& id : ids) {
        const auto run = RunCliWith({"explain", id});
        EXPECT_EQ(run.status, 0) << id << ": " << run.err;
        std::smatch found;
        EXPECT_TRUE(std::regex_match(run.out, found, sections) && found[1] == id) << run.out;
    }
    const auto misspelt = RunCliWith({"explain", "licence.approved"});
    EXPECT_EQ(misspelt.status, 2);
    EXPECT_NE(misspelt.err.find("did you mean 'license.approved'?"), std::string::npos) << misspelt.err;
}

// Save checks, fix-up notes and the Tracker's findings come from three places in three orders:
// an editor's list wants them by line and column, as compilers write them.
TEST(Checker, TextLinesAreCompilerStyleInTheOrderOfTheFile)
{
    TempDir dir;
    const auto part = dir.write("3001.dat", "0 Brick 2 x 4\r\n0 Name: 3001.dat\r\n0 Author: Sam Sample\r\n" +
                                                Header.substr(Header.find("0 !LDRAW_ORG")) + TrailingZero +
                                                "0 ROTATION CENTER 0 0 0 1 \"x\"\r\n" + LeadingZero);
    const auto run = RunCliWith({"check", "--tracker", "--quiet", part});
    const std::regex form("^" + part + R"(:(\d+):(\d+): (error|warning|note): .+ \[[a-z.-]+\]$)");
    std::vector<std::pair<int, int>> places;
    for (const auto& line : linesOf(run.out)) {
        std::smatch found;
        ASSERT_TRUE(std::regex_match(line, found, form)) << line;
        places.emplace_back(std::stoi(found[1]), std::stoi(found[2]));
    }
    EXPECT_TRUE(std::is_sorted(places.begin(), places.end())) << run.out;
    const std::set<std::string> expected = {
        "save.username",         "save.fixup.rotation",  "warning.descriptionnumbers",
        "numbers.trailingzeros", "numbers.leadingzeros", "line.invalid"};
    EXPECT_EQ(idsIn(run.out), expected) << run.out;
    EXPECT_EQ(places.front(), std::pair(1, 1)) << "the description's line, and the note about the whole body";
}

TEST(Checker, SelectAndIgnoreTakeIdsAndGroupsAndFailOnSetsTheExitStatus)
{
    TempDir dir;
    const auto part =
        dir.write("3001.dat", "0 Brick 2 x 4" + Header.substr(Header.find("\r\n")) + TrailingZero + LeadingZero);
    const auto ids = [&](const std::vector<std::string>& options) {
        std::vector<std::string> args = {"check", "--tracker", "--quiet", part};
        args.insert(args.end(), options.begin(), options.end());
        return idsIn(RunCliWith(args).out);
    };
    EXPECT_EQ(ids({}),
              (std::set<std::string>{"warning.descriptionnumbers", "numbers.trailingzeros", "numbers.leadingzeros"}));
    EXPECT_EQ(ids({"--select", "numbers."}), (std::set<std::string>{"numbers.trailingzeros", "numbers.leadingzeros"}));
    EXPECT_EQ(ids({"--select", "numbers.,warning.descriptionnumbers", "--ignore", "numbers.leadingzeros"}),
              (std::set<std::string>{"warning.descriptionnumbers", "numbers.trailingzeros"}));
    for (const auto* notAGroup : {"numbers", "number.", "numbers.leadingzero"}) {
        const auto run = RunCliWith({"check", "--select", notAGroup, part});
        EXPECT_EQ(run.status, 2) << notAGroup;
        EXPECT_NE(run.err.find("is no rule's id"), std::string::npos) << run.err;
    }
    const auto status = [&](const std::vector<std::string>& options) {
        std::vector<std::string> args = {"check", "--tracker", "--quiet", part};
        args.insert(args.end(), options.begin(), options.end());
        return RunCliWith(args).status;
    };
    EXPECT_EQ(status({}), 1);
    EXPECT_EQ(status({"--ignore", "numbers."}), 0) << "a warning alone passes";
    EXPECT_EQ(status({"--ignore", "numbers.", "--fail-on", "warning"}), 1);
    EXPECT_EQ(status({"--fail-on", "never"}), 0);
}

// ruff's and EditorConfig's way: the nearest quillmark.toml above a file holds, its globs are
// relative to its own folder, whatever the working folder.
TEST(Checker, TheNearestConfigFileAboveAFileHoldsWithGlobsFromItsFolder)
{
    TempDir dir;
    fs::create_directories(dir.path() / "lib/parts/s");
    fs::create_directories(dir.path() / "lib/parts/extra/s");
    fs::create_directories(dir.path() / "lib/own");
    dir.write("lib/quillmark.toml", "# the library's settings\nselect = [\"numbers.\", \"save.\"]\n"
                                    "fail-on = \"warning\"\n\n[per-file-ignores]\n"
                                    "\"parts/s/*.dat\" = [\"numbers.trailingzeros\"]\n");
    dir.write("lib/own/quillmark.toml", "ignore = [\"numbers.leadingzeros\"]\n");
    const auto body = TrailingZero + LeadingZero;
    dir.write("lib/parts/s/a.dat", Header + body);
    dir.write("lib/parts/extra/s/b.dat", Header + body);
    dir.write("lib/own/c.dat", Header + body);
    const auto run = checkIn(dir.path() / "lib/parts/extra", {"check", "--tracker", "--quiet", "../.."});
    const auto has = [&](const std::string& file, const char* id) {
        return run.out.find(file + ":") != std::string::npos &&
               std::regex_search(run.out, std::regex(file + R"(:\d+:\d+: [a-z]+: .*\[)" + id + "\\]"));
    };
    EXPECT_FALSE(has("../../parts/s/a.dat", "numbers.trailingzeros")) << run.out;
    EXPECT_TRUE(has("../../parts/s/a.dat", "numbers.leadingzeros")) << run.out;
    EXPECT_TRUE(has("../../parts/extra/s/b.dat", "numbers.trailingzeros")) << "not below the config's parts/s";
    EXPECT_TRUE(has("../../own/c.dat", "numbers.trailingzeros")) << "its own config, without select";
    EXPECT_FALSE(has("../../own/c.dat", "numbers.leadingzeros")) << run.out;
    EXPECT_EQ(run.status, 1);
    const auto isolated = checkIn(dir.path() / "lib", {"check", "--tracker", "--quiet", "--isolated", "parts/s"});
    EXPECT_TRUE(std::regex_search(isolated.out, std::regex("a.dat:.*numbers.trailingzeros")));
    const auto named =
        checkIn(dir.path() / "lib", {"check", "--tracker", "--quiet", "--config", "own/quillmark.toml", "parts/s"});
    EXPECT_TRUE(std::regex_search(named.out, std::regex("a.dat:.*numbers.trailingzeros"))) << named.out;
    EXPECT_FALSE(std::regex_search(named.out, std::regex("numbers.leadingzeros"))) << named.out;
}

TEST(Checker, AnUnknownKeyOrIdInAConfigFileIsAnErrorNamingFileAndLine)
{
    TempDir dir;
    dir.write("3001.dat", Header + TrailingZero);
    for (const auto& [config, said] :
         {std::pair<std::string, std::string>{"select = [\"numbers.\"]\n\nfail_on = \"warning\"\n",
                                              "quillmark.toml:3: unknown key 'fail_on'; did you mean 'fail-on'?"},
          {"[per-file-ignores]\n\"*.dat\" = [\n  \"numbers.leadingzero\"]\n",
           "quillmark.toml:3: 'numbers.leadingzero' is no rule's id; did you mean 'numbers.leadingzeros'?"},
          {"fail-on = \"sometimes\"\n", "quillmark.toml:1: fail-on is"},
          {"select = [\"numbers.\"\n", "quillmark.toml:"}}) {
        dir.write("quillmark.toml", config);
        const auto run = checkIn(dir.path(), {"check", "--tracker", "--quiet", "3001.dat"});
        EXPECT_EQ(run.status, 2) << config;
        EXPECT_NE(run.err.find("quillmark-cli: " + dir.file(said)), std::string::npos) << run.err;
        EXPECT_EQ(run.out, "") << "no file checked under a wrong config";
        const auto named = checkIn(dir.path(), {"check", "--config", "quillmark.toml", "3001.dat"});
        EXPECT_EQ(named.status, 2) << config;
    }
}

// Under the Tracker's rules a long description only warns: the Tracker takes it. A save (and check
// without --tracker) refuses it unless the limit is lifted.
TEST(Checker, ALongDescriptionIsAWarningUnderTheTrackersRules)
{
    TempDir dir;
    const std::string description = "0 Brick  2 x  4 with a Description Long Enough to Pass the Limit of 64";
    const auto part =
        dir.write("3001.dat", description + Header.substr(Header.find("\r\n")) + "3 16 0 0 0 1 0 0 0 1 0\r\n");
    const auto tracker = RunCliWith({"check", "--tracker", "--quiet", part});
    EXPECT_EQ(tracker.status, 0) << tracker.out;
    const auto characters = std::to_string(description.size() - 2);
    EXPECT_NE(tracker.out.find(part + ":1:3: warning: The description has " + characters + " characters"),
              std::string::npos)
        << tracker.out;
    EXPECT_EQ(RunCliWith({"check", "--tracker", "--quiet", "--fail-on", "warning", part}).status, 1);
    const auto json = nlohmann::json::parse(RunCliWith({"check", "--tracker", "--json", part}).out);
    EXPECT_EQ(json["refusals"].size(), 0u);
    EXPECT_EQ(json["warnings"][0]["id"], SaveCheckIds::DescriptionLength);
    const auto plain = RunCliWith({"check", "--quiet", part});
    EXPECT_EQ(plain.status, 1);
    EXPECT_NE(plain.out.find(part + ":1:3: error: Length of the part description"), std::string::npos) << plain.out;
    EXPECT_EQ(RunCliWith({"check", "--tracker", "--quiet", "--no-length-limit", part}).out, part + ": ok\n");
}

// Code scanning resolves URIs against %SRCROOT%, and merges results with equal prints.
TEST(Checker, SarifUrisAreRelativeToTheWorkingFolderAndEqualFindingsKeepTheirOwnPrints)
{
    TempDir dir, elsewhere;
    fs::create_directory(dir.path() / "parts");
    dir.write("parts/3001.dat", Header + TrailingZero + TrailingZero);
    const auto outside = elsewhere.write("3001.dat", Header + LeadingZero);
    const auto run = checkIn(dir.path(), {"check", "--tracker", "--format", "sarif", "parts", outside});
    EXPECT_EQ(run.status, 1);
    const auto log = nlohmann::json::parse(run.out);
    const auto& logRun = log["runs"][0];
    const auto root = logRun["originalUriBaseIds"]["%SRCROOT%"]["uri"].get<std::string>();
    EXPECT_EQ(root, "file://" + fs::canonical(dir.path()).string() + "/");
    std::set<std::string> prints;
    std::size_t inParts = 0, fromOutside = 0;
    for (const auto& result : logRun["results"]) {
        const auto& artifact = result["locations"][0]["physicalLocation"]["artifactLocation"];
        if (artifact["uri"] == "parts/3001.dat") {
            EXPECT_EQ(artifact["uriBaseId"], "%SRCROOT%");
            ++inParts;
        } else {
            EXPECT_EQ(artifact["uri"], "file://" + fs::canonical(outside).string());
            EXPECT_FALSE(artifact.contains("uriBaseId"));
            ++fromOutside;
        }
        prints.insert(result["partialFingerprints"]["findingHash/v1"].get<std::string>());
        const auto& rule = logRun["tool"]["driver"]["rules"][result["ruleIndex"].get<std::size_t>()];
        EXPECT_EQ(rule["id"], result["ruleId"]);
        EXPECT_TRUE(rule["helpUri"].get<std::string>().ends_with("docs/rules.md#" + rule["id"].get<std::string>()));
    }
    EXPECT_GE(inParts, 2u) << "the same finding on two lines";
    EXPECT_EQ(fromOutside, 1u);
    EXPECT_EQ(prints.size(), inParts + fromOutside) << "each result its own print";
}

// Actions knows ::error, ::warning and ::notice (a ::note vanishes), and its paths are those of the
// workspace.
TEST(Checker, GithubAnnotationsAreNoticesAndPathsOfTheWorkspace)
{
    TempDir dir;
    fs::create_directories(dir.path() / "repo/parts");
    dir.write("repo/parts/3001.dat", Header + "0 ROTATION CENTER 0 0 0 1 \"x\"\r\n");
    const auto run = RunCliInChild({"check", "--format", "github", "repo/parts"}, [&dir] {
        fs::current_path(dir.path());
        ::setenv("GITHUB_WORKSPACE", dir.file("repo").c_str(), 1);
    });
    EXPECT_NE(run.out.find("::notice file=parts/3001.dat,"), std::string::npos) << run.out;
    EXPECT_NE(run.out.find(",title=save.fixup.rotation::"), std::string::npos) << run.out;
    const auto here = checkIn(dir.path(), {"check", "--format", "github", "repo/parts"});
    EXPECT_NE(here.out.find("::notice file=repo/parts/3001.dat,"), std::string::npos) << here.out;
}

} // namespace
