// SPDX-License-Identifier: MIT
// What quillmark-cli refuses on its command line before it reads any file, and how it says so.
#include <gtest/gtest.h>

#include <fstream>
#include <regex>
#include <sstream>

#include "CliRun.h"
#include "TempDir.h"

namespace {

// An edit of one file that does not exist: a value refused up front never gets to reading it.
CliRun editWith(const std::string& option, const std::string& value)
{
    std::vector<std::string> args = {"edit", option, value};
    if (option == "--add-history")
        args.insert(args.end(), {"--as", "jtester"});
    if (option == "--as")
        args.insert(args.end(), {"--add-history", "x"});
    args.insert(args.end(), {"--no-backup", "/nonexistent/a.dat"});
    return RunCliWith(args);
}

bool refused(const CliRun& run, const std::string& option, const std::string& why)
{
    return run.status == 2 && run.out.empty() && run.err.find("cannot read") == std::string::npos &&
           run.err.find(option) != std::string::npos && run.err.find(why) != std::string::npos;
}

TEST(CliValues, NoControlCharacterGetsIntoAHeaderLineAndTabsOnlyWhereTheyStay)
{
    const std::vector<std::string> options = {"--description",     "--author",      "--type",     "--update",
                                              "--license",         "--bfc",         "--category", "--add-keywords",
                                              "--remove-keywords", "--add-history", "--as"};
    for (const auto& option : options)
        for (const char control : {'\x01', '\t', '\n', '\r', '\x1b', '\x7f'}) {
            const auto run = editWith(option, std::string("a") + control + "1 16 0 0 0 1 0 0 0 1 0 0 0 1 b.dat");
            char code[8];
            std::snprintf(code, sizeof code, "0x%02X", static_cast<unsigned char>(control));
            const bool tabStays = control == '\t' && (option == "--add-keywords" || option == "--remove-keywords" ||
                                                      option == "--add-history");
            if (tabStays)
                EXPECT_EQ(run.err.find("quillmark-cli: cannot read /nonexistent/a.dat"), 0u) << option;
            else
                EXPECT_TRUE(refused(run, option, code)) << option << " " << code << ": " << run.err;
        }
}

TEST(CliValues, UpdateTagsAreYearAndReleaseAndUserNamesUseTheTrackersCharacters)
{
    for (const auto* tag : {"-------", "20-4-01", "2024-0-", "2024-001", "2024_01", "２０２４-01"})
        EXPECT_TRUE(refused(editWith("--update", tag), "--update", "is not YYYY-RR")) << tag;
    for (const auto& [option, value] : {std::pair{"--as", "tester]"}, std::pair{"--as", "jo tester"},
                                        std::pair{"--author", "Eve [e/ve]"}, std::pair{"--author", "Eve [j\xc3\xb6]"}})
        EXPECT_TRUE(refused(editWith(option, value), option, "names a user")) << value;
    for (const auto& [option, value] :
         {std::pair{"--update", "2024-01"}, std::pair{"--as", "J.Tester_1-x"},
          std::pair{"--author", "Jens Br\xc3\xbchl [jbruehl]"}, std::pair{"--author", "Eve (no user)"}})
        EXPECT_EQ(editWith(option, value).err.find("cannot read"), 15u) << value << " is taken";
}

TEST(CliValues, AMistypedCommandGetsTheClosestAndAnUnreadableLDConfigIsAnError)
{
    const auto typo = RunCliWith({"chek", "x.dat"});
    EXPECT_EQ(typo.status, 2);
    EXPECT_EQ(typo.err, "quillmark-cli: unknown command 'chek'; did you mean 'check'?\n"
                        "Run quillmark-cli --help for the commands.\n");
    EXPECT_EQ(RunCliWith({"zzzzzz"}).err.find("did you mean"), std::string::npos);
    TempDir dir;
    const auto part = dir.write("a.dat", "0 a\r\n");
    const auto ldconfig = RunCliWith({"check", "--tracker", "--ldconfig", dir.file("LDConfig.ldr"), part});
    EXPECT_EQ(ldconfig.status, 2);
    EXPECT_EQ(ldconfig.out, "");
    EXPECT_EQ(RunCliWith({"check", "--tracker", "--ldconfig", dir.path().string(), part}).status, 2) << "a folder";
}

// The commands that quillmark-cli --help lists.
std::vector<std::string> commandsOfTheHelp()
{
    std::vector<std::string> commands;
    std::istringstream lines(RunCliWith({"--help"}).out);
    bool inCommands = false;
    for (std::string line; std::getline(lines, line);) {
        if (line == "Subcommands:")
            inCommands = true;
        else if (std::smatch found; inCommands && std::regex_search(line, found, std::regex(R"(^  ([a-z]+) )")))
            commands.push_back(found.str(1));
    }
    return commands;
}

// Every command and every option that the --help texts list is described in the manual page,
// and every command's --help ends with its exit statuses.
TEST(CliValues, TheManualPageDescribesEveryCommandAndItsOptions)
{
    std::ifstream file(QUILLMARK_CLI_MAN_PAGE);
    std::stringstream read;
    read << file.rdbuf();
    const auto page = read.str();
    const auto commands = commandsOfTheHelp();
    EXPECT_GE(commands.size(), 6u);
    const std::regex option(R"(^  (-\w,)?(--[a-z-]+))");
    for (const auto& command : commands) {
        EXPECT_NE(page.find("\n.B quillmark-cli " + command + "\n"), std::string::npos) << command << " in SYNOPSIS";
        EXPECT_NE(page.find("\n.BI " + command + " \""), std::string::npos) << command << " in COMMANDS";
        const auto help = RunCliWith({command, "--help"}).out;
        EXPECT_NE(help.find("\nExit status:\n  0  "), std::string::npos) << command;
        std::istringstream lines(help);
        for (std::string line; std::getline(lines, line);) {
            std::smatch found;
            if (!std::regex_search(line, found, option))
                continue;
            const auto roff = std::regex_replace(found.str(0).substr(2), std::regex("-"), "\\-");
            EXPECT_NE(page.find(roff), std::string::npos) << command << " " << found.str(0);
        }
    }
    for (const auto* section :
         {"NAME", "SYNOPSIS", "DESCRIPTION", "COMMANDS", "OPTIONS", "EXIT STATUS", "FILES", "EXAMPLES", "SEE ALSO"})
        EXPECT_NE(page.find(std::string("\n.SH ") + section + "\n"), std::string::npos) << section;
    // The folder of the copies that saves in others' folders keep.
    EXPECT_NE(page.find("\n.I ~/.local/state/Quillmark/keep/\n"), std::string::npos);
}

} // namespace
