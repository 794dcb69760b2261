#include <gtest/gtest.h>

#include <filesystem>
#include <nlohmann/json.hpp>

#include "CliRun.h"
#include "TempDir.h"

namespace fs = std::filesystem;

namespace {

const std::string GoodPart =
    "0 Brick 2 x 4\r\n0 Name: 3001.dat\r\n0 Author: Sam Sample [ssample]\r\n"
    "0 !LDRAW_ORG Part UPDATE 2004-01\r\n0 !LICENSE Licensed under CC BY 4.0 : see CAreadme.txt\r\n"
    "0 BFC CERTIFY CCW\r\n1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat\r\n";
const std::string NoAuthorPart = "0 Brick\r\n0 COLOR 4 red\r\n0 ROTATION CENTER 0 0 0\r\n1 16 a.dat\r\n";
const std::string NoUserPart = "0 Brick\r\n0 Author: Sam Sample\r\n0 !LDRAW_ORG Part\r\n0 !LICENSE L\r\n"
                               "0 BFC CERTIFY CCW\r\n0 WRITE hello\r\n1 16 a.dat\r\n";

TEST(CliCheck, ListsEveryFindingAndNeverWrites)
{
    TempDir dir;
    const auto good = dir.write("good.dat", GoodPart);
    const auto bad = dir.write("bad.dat", NoAuthorPart);
    const auto run = RunCliWith({"check", good, bad});
    EXPECT_EQ(run.status, 1);
    EXPECT_NE(run.out.find(good + ": ok\n"), std::string::npos);
    EXPECT_NE(run.out.find(bad + ": refused: You need to mention the Author!\n"), std::string::npos);
    EXPECT_NE(run.out.find(bad + ": refused: You need to set the BFC type!\n"), std::string::npos);
    EXPECT_NE(run.out.find(bad + ": missing user name\n"), std::string::npos);
    EXPECT_NE(run.out.find(bad + ": fix-up offered: 0 ROTATION lines in the body\n"), std::string::npos);
    EXPECT_EQ(ReadBytes(bad), NoAuthorPart);
    EXPECT_EQ(std::distance(fs::directory_iterator(dir.path()), fs::directory_iterator()), 2);
}

TEST(CliCheck, JsonObjectPerFile)
{
    TempDir dir;
    const auto bad = dir.write("bad.dat", NoAuthorPart);
    const auto run = RunCliWith({"check", "--json", bad});
    const auto json = nlohmann::json::parse(run.out);
    EXPECT_EQ(json["FilePath"], bad);
    EXPECT_EQ(json["refusals"].size(), 4u);
    EXPECT_EQ(json["refusals"][0], "You need to mention the Author!\r\nSaving the file is not possible");
    EXPECT_EQ(json["missing_username"], true);
    EXPECT_EQ(json["fixups"],
              (nlohmann::json{{"certify_invertnext", false}, {"rotation", true}, {"write", false}, {"color", true}}));
}

TEST(CliCheck, GoodFilesExitZeroUnreadableTwo)
{
    TempDir dir;
    const auto good = dir.write("good.dat", GoodPart);
    EXPECT_EQ(RunCliWith({"check", good}).status, 0);
    EXPECT_EQ(RunCliWith({"check", good, dir.file("nope.dat")}).status, 2);
}

TEST(CliSave, SavesGoodFilesWithBackupAndSkipsRefusedOnes)
{
    TempDir dir;
    const auto good = dir.write("good.dat", GoodPart);
    const auto bad = dir.write("bad.dat", NoAuthorPart);
    const auto printed = RunCliWith({"print", good}).out;
    const auto run = RunCliWith({"save", good, bad});
    EXPECT_EQ(run.status, 1);
    EXPECT_EQ(ReadBytes(good), printed);
    EXPECT_EQ(ReadBytes(bad), NoAuthorPart);
    EXPECT_NE(run.out.find("saved " + good + " (backup: " + dir.path().string() + "/good_Backup_"), std::string::npos);
    EXPECT_NE(run.out.find("skipped " + bad + ": You need to mention the Author!\n"), std::string::npos);
    EXPECT_NE(run.err.find("You need to mention the Author!"), std::string::npos);
    EXPECT_EQ(std::distance(fs::directory_iterator(dir.path()), fs::directory_iterator()), 3);
}

TEST(CliSave, MissingUserNameNeedsItsFlagAndFixOnlyWithItsFlag)
{
    TempDir dir;
    const auto part = dir.write("nouser.dat", NoUserPart);
    auto run = RunCliWith({"save", "--no-backup", part});
    EXPECT_EQ(run.status, 1);
    EXPECT_NE(run.out.find("skipped " + part), std::string::npos);
    EXPECT_EQ(ReadBytes(part), NoUserPart);

    run = RunCliWith({"save", "--no-backup", "--allow-missing-username", part});
    EXPECT_EQ(run.status, 0);
    EXPECT_NE(ReadBytes(part).find("0 WRITE hello"), std::string::npos);

    run = RunCliWith({"save", "--no-backup", "--allow-missing-username", "--fix", part});
    EXPECT_EQ(run.status, 0);
    EXPECT_EQ(ReadBytes(part).find("WRITE"), std::string::npos);
    EXPECT_NE(ReadBytes(part).find("0 hello"), std::string::npos);
    EXPECT_EQ(std::distance(fs::directory_iterator(dir.path()), fs::directory_iterator()), 1);
}

TEST(CliSave, FailedSaveExitsThree)
{
    TempDir dir;
    const auto part = dir.write("noext", GoodPart);
    const auto run = RunCliWith({"save", part});
    EXPECT_EQ(run.status, 3);
    EXPECT_NE(run.out.find("failed " + part + ": Error 5 "), std::string::npos);
    EXPECT_EQ(ReadBytes(part), GoodPart);
}

} // namespace
