#include <gtest/gtest.h>

#include <algorithm>
#include <nlohmann/json.hpp>
#include <sstream>

#include "CliRun.h"
#include "TempDir.h"

namespace {

const std::string SamplePart = "0 Brick\t2 x 4\r\n0 Name: 3001.dat\r\n0 Author: Sam Sample [ssample]\r\n"
                               "0 BFC CERTIFY CCW\r\n0 !KEYWORDS a, b\r\n0 Caf\xe9\r\n"
                               "1 16 0 0 0 1 0 0 0 1 0 0 0 1 3001s01.dat\r\n";

TEST(CliFields, OneJsonLinePerFileWithTheRecordAsOpened)
{
    TempDir dir;
    const auto path = dir.write("3001.dat", SamplePart);
    const auto run = RunCliWith({"fields", path, path});
    EXPECT_EQ(run.status, 0);
    std::istringstream lines(run.out);
    std::string line;
    int count = 0;
    while (std::getline(lines, line)) {
        ++count;
        const auto json = nlohmann::json::parse(line);
        EXPECT_EQ(json.size(), 21u);
        EXPECT_EQ(json["FilePath"], path);
        EXPECT_EQ(json["FileFolder"], dir.path().string());
        EXPECT_EQ(json["PartName"], "3001.dat");
        EXPECT_EQ(json["PartDescription"], "Brick2 x 4");
        EXPECT_EQ(json["NeedsWork"], false);
        EXPECT_EQ(json["AuthorRealName"], "Sam Sample");
        EXPECT_EQ(json["Keywords"], nlohmann::json::array({"a, b"}));
        EXPECT_EQ(json["Body"], "0 Caf\u00e9\r\n1 16 0 0 0 1 0 0 0 1 0 0 0 1 3001s01.dat");
    }
    EXPECT_EQ(count, 2);
    EXPECT_NE(run.err.find("A TAB character was found"), std::string::npos);
}

TEST(CliFields, UnreadableFileIsNamedOnStandardErrorAndTheOthersStillRun)
{
    TempDir dir;
    const auto good = dir.write("good.dat", "0 Good\r\n");
    const auto run = RunCliWith({"fields", dir.file("missing.dat"), good});
    EXPECT_EQ(run.status, 2);
    EXPECT_EQ(std::count(run.out.begin(), run.out.end(), '\n'), 1);
    EXPECT_NE(run.out.find("\"Good\""), std::string::npos);
    EXPECT_NE(run.err.find(dir.file("missing.dat")), std::string::npos);
    EXPECT_EQ(std::count(run.err.begin(), run.err.end(), '\n'), 1);
}

TEST(CliPrint, WritesTheComposedHeaderTheBodyAndOneCrLf)
{
    TempDir dir;
    const auto run = RunCliWith({"print", dir.write("3001.dat", SamplePart)});
    EXPECT_EQ(run.status, 0);
    EXPECT_EQ(run.out, "0 Brick2 x 4\r\n0 Name: 3001.dat\r\n0 Author: Sam Sample [ssample]\r\n\r\n"
                       "0 BFC CERTIFY CCW\r\n\r\n0 !KEYWORDS a, b\r\n\r\n"
                       "0 Caf\xe9\r\n1 16 0 0 0 1 0 0 0 1 0 0 0 1 3001s01.dat\r\n");
}

TEST(CliPrint, MissingFileGivesStatusTwoAndNoOutput)
{
    const auto run = RunCliWith({"print", "/nonexistent/folder/x.dat"});
    EXPECT_EQ(run.status, 2);
    EXPECT_EQ(run.out, "");
    EXPECT_NE(run.err.find("/nonexistent/folder/x.dat"), std::string::npos);
}

} // namespace
