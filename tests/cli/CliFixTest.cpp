// SPDX-License-Identifier: MIT
// fix edits the file as it stands: only the lines of its repairs change, whatever the line ends,
// whatever the save checks say; its log names each edit, its diff applies with patch.
#include <gtest/gtest.h>

#include <filesystem>

#include "CliRun.h"
#include "LineEndText.h"
#include "TempDir.h"

namespace fs = std::filesystem;

namespace {

// A part the Tracker refuses for its old licence and a number, which the save checks refuse too
// (no BFC line), with lines no repair is about: a help line with two blanks, a comment, a body
// line ending in a blank.
const std::string OldPart = "0 Brick  2 x  4\r\n0 Name: 3001.dat\r\n0 Author: Jane Doe [jdoe]\r\n"
                            "0 !LDRAW_ORG Part UPDATE 2004-01\r\n"
                            "0 !LICENSE Redistributable under CCAL version 2.0 : see CAreadme.txt\r\n"
                            "0 !HELP  left arm\r\n\r\n0 !HISTORY 2004-01-01 [jdoe] Made\r\n\r\n"
                            "1 16 0 0 0 1 0 0 0 1 0 0 0 1 stud.dat \r\n"
                            "3 16 1.50 0 0 1 0 0 0 1 0\r\n0 // end\r\n";

std::string replaced(std::string text, const std::string& what, const std::string& with)
{
    return text.replace(text.find(what), what.size(), with);
}

const std::string NewLicence = "Licensed under CC BY 2.0 and CC BY 4.0 : see CAreadme.txt";

std::string repaired(const std::string& part)
{
    return replaced(replaced(part, "Redistributable under CCAL version 2.0 : see CAreadme.txt", NewLicence),
                    "3 16 1.50", "3 16 1.5");
}

TEST(CliFix, OnlyTheRepairedLinesChangeWhateverTheLineEnds)
{
    TempDir dir;
    // The mixed file: CR LF, then LF at the end of the comment lines and a lone CR inside one.
    const auto mixed = replaced(OldPart, "0 // end\r\n", "0 // a\n0 // e\rnd\n");
    const std::vector<std::pair<std::string, std::string>> parts = {
        {"crlf.dat", OldPart}, {"lf.dat", WithLineEnds(OldPart, "\n")}, {"mixed.dat", mixed}};
    std::vector<std::string> args = {"fix", "--allow-missing-username"};
    for (const auto& [name, bytes] : parts) {
        dir.write(name, bytes);
        args.push_back(dir.file(name));
    }
    const auto run = RunCliWith(args);
    EXPECT_EQ(run.status, 0) << run.out << run.err;
    for (const auto& [name, bytes] : parts) {
        EXPECT_EQ(ReadBytes(dir.file(name)), repaired(bytes)) << name << ": the save checks refuse it, yet it is fixed";
        EXPECT_NE(run.out.find(dir.file(name) + ": fixed license.approved (line 5)\n"), std::string::npos) << run.out;
        EXPECT_NE(run.out.find(dir.file(name) + ": fixed numbers.trailingzeros (1 number, line 11)\n"),
                  std::string::npos)
            << run.out;
    }
    int files = 0;
    for ([[maybe_unused]] const auto& entry : fs::directory_iterator(dir.path()))
        ++files;
    EXPECT_EQ(files, 3) << "no backup without --backup";
}

TEST(CliFix, AddedLinesGoWhereTheHeaderOrderPutsThemWithTheFilesLineEnd)
{
    TempDir dir;
    const auto lf = WithLineEnds(OldPart, "\n");
    dir.write("a.dat", lf);
    dir.write("b.dat", replaced(lf, "0 !HISTORY 2004-01-01 [jdoe] Made\n\n", ""));
    const auto run = RunCliWith({"fix", "--only", "license.approved", "--add-history", "Licence", "--as", "ann",
                                 dir.file("a.dat"), dir.file("b.dat")});
    EXPECT_EQ(run.status, 0) << run.err;
    const auto added = ReadBytes(dir.file("a.dat"));
    const auto line = added.find("\n0 !HISTORY ", added.find("[jdoe] Made\n"));
    ASSERT_NE(line, std::string::npos) << added;
    EXPECT_NE(added.find(" [ann] Licence\n\n1 16"), std::string::npos) << "after the last history line\n" << added;
    const auto first = ReadBytes(dir.file("b.dat"));
    EXPECT_NE(first.find("0 !HELP  left arm\n0 !HISTORY "), std::string::npos) << "after the help line\n" << first;
    EXPECT_EQ(first.find('\r'), std::string::npos) << first;
}

TEST(CliFix, AFileTheTrackersRulesStopAtIsLeftAndSaysWhy)
{
    TempDir dir;
    const auto part = replaced(OldPart, "0 !LDRAW_ORG Part UPDATE 2004-01\r\n", "");
    dir.write("a.dat", part);
    const auto run = RunCliWith({"fix", dir.file("a.dat")});
    EXPECT_EQ(run.status, 1);
    EXPECT_NE(run.out.find("left " + dir.file("a.dat") + ": missing: "), std::string::npos) << run.out;
    EXPECT_EQ(run.out.find("fixed"), std::string::npos) << run.out;
    EXPECT_EQ(ReadBytes(dir.file("a.dat")), part);
}

TEST(CliFix, AMisspeltRepairIsRefusedWithTheNearestOne)
{
    TempDir dir;
    dir.write("a.dat", OldPart);
    const auto run = RunCliWith({"fix", "--only", "license.aproved", dir.file("a.dat")});
    EXPECT_EQ(run.status, 2);
    EXPECT_NE(run.err.find("license.aproved"), std::string::npos) << run.err;
    EXPECT_NE(run.err.find("did you mean license.approved?"), std::string::npos) << run.err;
    EXPECT_EQ(ReadBytes(dir.file("a.dat")), OldPart);
}

// patch reads a name up to a blank unless it is quoted: a name that ends in one must be, or the
// diff patches another file.
TEST(CliFix, TheDryRunsDiffPatchesAFileWhoseNameEndsInABlank)
{
    TempDir dir;
    fs::create_directories(dir.path() / "lib");
    dir.write("lib/a.dat ", OldPart);
    dir.write("lib/a.dat", "0 another file\r\n");
    const auto run = RunCliInChild({"fix", "--dry-run", "lib/a.dat "}, [&dir] { fs::current_path(dir.path()); });
    EXPECT_NE(run.out.find("--- \"a/lib/a.dat \"\n+++ \"b/lib/a.dat \"\n"), std::string::npos) << run.out;
    EXPECT_EQ(ReadBytes(dir.file("lib/a.dat ")), OldPart) << "a dry run writes nothing";
    TempDir::writeTo(dir.file("fix.diff"), run.out);
    ASSERT_EQ(std::system(("cd '" + dir.path().string() + "' && patch -s -p1 <fix.diff").c_str()), 0);
    EXPECT_EQ(ReadBytes(dir.file("lib/a.dat ")), repaired(OldPart));
    EXPECT_EQ(ReadBytes(dir.file("lib/a.dat")), "0 another file\r\n");
}

} // namespace
