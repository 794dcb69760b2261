// SPDX-License-Identifier: MIT
// Where the colour codes come from, and the corpus read with the built-in ones.
#include <gtest/gtest.h>

#include <filesystem>

#include "ColourSource.h"
#include "Corpus.h"
#include "TempDir.h"
#include "TrackerTestParts.h"

namespace {

const std::string OnlyRed = "0 !COLOUR Red CODE 4 VALUE #C91A09 EDGE #333333\r\n";

ColourCodes builtIn() { return ReadBuiltInColours(QUILLMARK_DATA_DIR "/" + std::string(BuiltInColoursFile)); }

struct Reports {
    std::vector<std::string> texts;
    ColourSource::Report report()
    {
        return [this](const std::string& text) { texts.push_back(text); };
    }
};

TEST(ColourSource, GivenFoundAboveOrBuiltIn)
{
    TempDir dir;
    std::filesystem::create_directories(dir.path() / "library/parts/s");
    dir.write("library/LDConfig.ldr", OnlyRed);
    const auto given = dir.write("mine.ldr", "0 !COLOUR Blue CODE 1 VALUE #0055BF EDGE #333333\r\n");
    Reports reports;
    ColourSource searching(builtIn(), "", reports.report());
    const auto& above = searching.forPart(dir.file("library/parts/s/3001s01.dat"), reports.report());
    EXPECT_TRUE(above.contains(4));
    EXPECT_FALSE(above.contains(16));
    EXPECT_EQ(&searching.forPart(dir.file("library/parts/3001.dat"), reports.report()), &above);
    const auto& none = searching.forPart(dir.file("other/3001.dat"), reports.report());
    EXPECT_TRUE(none.contains(16) && none.contains(10484) && !none.contains(48));
    ColourSource givenOne(builtIn(), given, reports.report());
    EXPECT_TRUE(givenOne.forPart(dir.file("library/parts/3001.dat"), reports.report()).contains(1));
    EXPECT_FALSE(givenOne.forPart(dir.file("library/parts/3001.dat"), reports.report()).contains(4));
    EXPECT_TRUE(reports.texts.empty());
}

TEST(ColourSource, AnUnusableLDConfigIsReportedOnceAndTheBuiltInListUsed)
{
    TempDir dir;
    std::filesystem::create_directories(dir.path() / "parts");
    dir.write("LDConfig.ldr", "0 !COLOUR Red CODE 4 VALUE red\r\n");
    Reports reports;
    ColourSource source(builtIn(), "", reports.report());
    EXPECT_TRUE(source.forPart(dir.file("parts/a.dat"), reports.report()).contains(16));
    EXPECT_TRUE(source.forPart(dir.file("parts/b.dat"), reports.report()).contains(16));
    ASSERT_EQ(reports.texts.size(), 1u);
    EXPECT_NE(reports.texts[0].find("LDConfig.ldr"), std::string::npos);
    ColourSource missing(builtIn(), dir.file("none.ldr"), reports.report());
    EXPECT_EQ(reports.texts.size(), 2u);
    EXPECT_TRUE(missing.forPart(dir.file("parts/a.dat"), reports.report()).contains(16));
    EXPECT_FALSE(ReadColourRanges("0-47,5x").has_value());
}

TEST(ColourSource, EveryCorpusFileIsCheckedWithKnownIdsOnly)
{
    const Ids known = {"missing",
                       "license.approved",
                       "type.phycolor",
                       "category.invalid",
                       "warning.minifigcategory",
                       "history.invalid",
                       "name.invalidchars",
                       "name.xparts",
                       "type.path",
                       "name.filename",
                       "description.subpartdesc",
                       "description.movedorobsolete",
                       "description.aliasdesc",
                       "description.thirdpartydesc",
                       "description.invalidchars",
                       "warning.descriptionnumbers",
                       "description.patternword",
                       "keywords.patternset",
                       "type.alias",
                       "type.flex",
                       "name.flex",
                       "bfc",
                       "obsoleteimproper",
                       "circularreference",
                       "warning.previewinvalid",
                       "line.invalid",
                       "numbers.decimalprecision",
                       "numbers.trailingzeros",
                       "numbers.leadingzeros",
                       "line.invalidcolor",
                       "line.invalidcolor24",
                       "line.invalidcoloredlines",
                       "line.singular",
                       "line.identicalpoints",
                       "line.colinear",
                       "line.notconvex",
                       "line.notcoplaner",
                       "warning.notcoplaner",
                       "warning.stickercolor"};
    const auto files = CorpusPartFiles();
    if (files.empty())
        GTEST_SKIP() << "no corpus folder beside the project";
    const auto codes = builtIn();
    Ids found;
    for (const auto& file : files)
        for (const auto& finding :
             CheckForTracker(ReadBytes(file.string()), file.filename().string(), Categories, codes))
            found.insert(finding.id);
    for (const auto& id : found)
        EXPECT_TRUE(known.contains(id)) << id;
    EXPECT_TRUE(found.contains("line.invalid") && found.contains("numbers.decimalprecision"));
}

} // namespace
