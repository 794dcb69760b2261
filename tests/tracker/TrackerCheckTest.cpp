// SPDX-License-Identifier: MIT
// The Parts Tracker's header rules: for each family a header that passes and one that breaks it.
#include <gtest/gtest.h>

#include <set>

#include "TrackerCheck.h"
#include "TrackerTestParts.h"

namespace {

TEST(TrackerRules, AMissingOrMalformedHeaderLineStopsEveryOtherRule)
{
    auto text = cleanPart("Brick 1 x 2", "x3001.dat");
    text.replace(text.find("Jane Doe [jdoe]"), 15, "Jane [j d]");
    const auto findings = CheckForTracker(text, "x3001.dat", Categories, Colours());
    ASSERT_EQ(findings.size(), 1u);
    EXPECT_EQ(findings[0].id, "authorinvalid");
    EXPECT_EQ(findings[0].level, FindingLevel::Error);
    EXPECT_EQ(idsOf(cleanPart("Brick", "3001.dat", "Mystery")), Ids{"missing"});
    EXPECT_EQ(idsOf(cleanPart("Brick", "3001.dat", "Part UPDATE 2004-3")), Ids{"missing"}) << "read as a whole";
    EXPECT_EQ(idsOf(cleanPart("Brick", "3001.dat", "Part\t UPDATE 2004-03")), Ids{}) << "its blanks collapsed";
    auto commentFirst = cleanPart();
    commentFirst.replace(0, commentFirst.find("\r\n"), "0 // Brick  2 x  4");
    EXPECT_EQ(idsOf(commentFirst), Ids{"missing"}) << "line 1 is a header meta, not the description";
    auto userOnly = cleanPart();
    userOnly.replace(userOnly.find("Jane Doe [jdoe]"), 15, "[jdoe]");
    EXPECT_EQ(idsOf(userOnly), Ids{});
}

TEST(TrackerRules, LicenceAndBfc)
{
    auto text = cleanPart();
    EXPECT_EQ(CheckForTracker(text, "3001.dat", Categories, Colours()).size(), 0u);
    text.replace(text.find("Licensed under CC BY 4.0"), 24, "Licensed  under CC BY 4.0"); // blanks collapse
    EXPECT_EQ(idsOf(text), Ids{});
    text.replace(text.find("CC BY 4.0"), 9, "CCAL 2.0");
    text.replace(text.find("CERTIFY CCW"), 11, "CERTIFY CW");
    EXPECT_EQ(idsOf(text), (Ids{"license.approved", "bfc"}));
}

TEST(TrackerRules, TypeQualifiersAndPaths)
{
    EXPECT_EQ(idsOf(cleanPart("~Brick Sub", "s\\3001s01.dat", "Subpart"), "3001s01.dat"), Ids{});
    EXPECT_EQ(idsOf(cleanPart("~Brick Sub", "3001s01.dat", "Subpart"), "3001s01.dat"), Ids{"type.path"});
    EXPECT_EQ(idsOf(cleanPart("Brick", "x3001.dat"), "x3001.dat"), Ids{"name.xparts"});
    EXPECT_EQ(idsOf(cleanPart("=Brick", "3001.dat", "Part Alias")), Ids{});
    EXPECT_EQ(idsOf(cleanPart("=Brick", "s\\3001.dat", "Subpart Alias")),
              (Ids{"type.alias", "description.subpartdesc"}));
    EXPECT_EQ(idsOf(cleanPart("Brick", "3001.dat", "Part Physical_Colour")), Ids{"type.phycolor"});
    EXPECT_EQ(idsOf(cleanPart("Hose Flex", "73590k01.dat", "Part Flexible_Section"), "73590k01.dat"), Ids{});
    EXPECT_EQ(idsOf(cleanPart("Hose Flex", "73590.dat", "Shortcut Flexible_Section"), "73590.dat"),
              (Ids{"type.flex", "name.flex"}));
    EXPECT_EQ(idsOf(cleanPart(), "3002.dat"), Ids{"name.filename"});
    EXPECT_EQ(idsOf(cleanPart("Hose Flex", "73590.dat", "Part Flexible_Section", "0 !CATEGORY Tyre\r\n"), "73590.dat"),
              Ids{"category.invalid"})
        << "no name rule for a flexible section of an unknown category";
    EXPECT_EQ(idsOf(cleanPart("~Brick Sub", "s\\x12.dat", "Subpart"), "12.dat"), (Ids{"name.xparts", "name.filename"}))
        << "the name is read, not the file's";
    EXPECT_EQ(idsOf(cleanPart("Brick", "s\\t12.dat"), "t12.dat"), Ids{"type.path"}) << "\"\\\" does not split it";
}

TEST(TrackerRules, DescriptionPrefixesAndCharacters)
{
    EXPECT_EQ(idsOf(cleanPart("Brick Sub", "s\\3001s01.dat", "Subpart"), "3001s01.dat"),
              Ids{"description.subpartdesc"});
    EXPECT_EQ(idsOf(cleanPart("Brick", "3001.dat", "Part Alias")), Ids{"description.aliasdesc"});
    EXPECT_EQ(idsOf(cleanPart("Brick", "t3001.dat"), "t3001.dat"), Ids{"description.thirdpartydesc"});
    EXPECT_EQ(idsOf(cleanPart("|Brick", "t3001.dat"), "t3001.dat"), Ids{});
    EXPECT_EQ(idsOf(cleanPart("Brick", "3001.dat", "Part", "0 !CATEGORY Moved\r\n")),
              Ids{"description.movedorobsolete"});
    EXPECT_EQ(idsOf(cleanPart("Brick\t2")), (Ids{"description.invalidchars", "warning.descriptionnumbers"}));
    for (const auto* other : {"\u200B", "\uE000", "\u0378"}) { // format, private use, unassigned
        EXPECT_EQ(idsOf(cleanPart(std::string("Brick x") + other + "x")), Ids{"description.invalidchars"}) << other;
        EXPECT_EQ(idsOf(cleanPart("Brick", std::string("3001") + other + ".dat")),
                  (Ids{"name.invalidchars", "name.filename"}))
            << other;
    }
    EXPECT_EQ(idsOf(cleanPart("Brick 1 x 2")), Ids{"warning.descriptionnumbers"});
    EXPECT_EQ(idsOf(cleanPart("Technic Ball Joint Type 2")), Ids{});
    EXPECT_EQ(idsOf(cleanPart("Brick with 1 White Stripe")), Ids{}) << "before White";
}

TEST(TrackerRules, CategoriesAndObsoleteParts)
{
    EXPECT_EQ(idsOf(cleanPart("Brick", "3001.dat", "Part", "0 !CATEGORY Tyre\r\n")), Ids{"category.invalid"});
    EXPECT_EQ(idsOf(cleanPart("Hat", "3001.dat", "Part", "0 !CATEGORY Minifig  \t Accessory\r\n")), Ids{});
    EXPECT_EQ(idsOf(cleanPart("Minifig Hat")), Ids{"warning.minifigcategory"});
    EXPECT_EQ(idsOf(cleanPart("~Brick (Obsolete)")), Ids{"obsoleteimproper"});
    EXPECT_EQ(idsOf(cleanPart("~Brick (Obsolete)", "3001.dat", "Part", "0 !CATEGORY Obsolete\r\n")), Ids{});
    EXPECT_EQ(idsOf(cleanPart("~Brick", "3001.dat", "Part", "0 !CATEGORY Obsolete\r\n")), Ids{"obsoleteimproper"});
}

TEST(TrackerRules, PatternsNeedTheirWordAndASetKeyword)
{
    const auto pattern = [](const std::string& description, const std::string& extra) {
        return idsOf(cleanPart(description, "3001p01.dat", "Part", extra), "3001p01.dat");
    };
    EXPECT_EQ(pattern("Brick with Stars Pattern (Blue)", "0 !KEYWORDS Set 6080\r\n"), Ids{});
    EXPECT_EQ(pattern("Brick with Stars", "0 !KEYWORDS cmf, stars\r\n"), Ids{"description.patternword"});
    EXPECT_EQ(pattern("Brick with Stars", "0 !KEYWORDS Colour Combination, Set 1\r\n"), Ids{});
    EXPECT_EQ(pattern("Brick with Stars Pattern", "0 !KEYWORDS stars\r\n"), Ids{"keywords.patternset"});
    EXPECT_EQ(idsOf(cleanPart("Brick with Stars"), "3001c01.dat"), Ids{"name.filename"}) << "c01 is no pattern";
}

TEST(TrackerRules, HistoryPreviewAndSelfReference)
{
    EXPECT_EQ(idsOf(cleanPart("Brick", "3001.dat", "Part",
                              "0 !HISTORY 2024-01-02 [jdoe] made\r\n0 !HISTORY 2024-01-03 {Jane Doe} fixed\r\n"
                              "0 !PREVIEW 16 0 0 0 0 0 1 0 1 0 -1 0 0\r\n")),
              Ids{});
    EXPECT_EQ(idsOf(cleanPart("Brick", "3001.dat", "Part", "0 !HISTORY 2024-1-2 [jdoe] made\r\n")),
              (Ids{"history.invalid", "line.invalid"}));
    EXPECT_EQ(idsOf(cleanPart("Brick", "3001.dat", "Part", "0 !HISTORY 2024-01-02 [jdoe]\r\n")),
              (Ids{"history.invalid", "line.invalid"}));
    EXPECT_EQ(idsOf(cleanPart("Brick", "3001.dat", "Part", "0 !PREVIEW 16 0 0 0 1 1 0 0 1 0 0 0 1\r\n")),
              Ids{"warning.previewinvalid"});
    EXPECT_EQ(idsOf(cleanPart("Brick", "3001.dat", "Part", "1 16 0 0 0 1 0 0 0 1 0 0 0 1 3001.DAT\r\n")),
              Ids{"circularreference"});
}

} // namespace

namespace {

bool warns(const std::string& description, const char* id = "warning.descriptionnumbers")
{
    return idsOf(cleanPart(description)).contains(id);
}

TEST(TrackerRules, AcceptedLicencesFoldersAndTheFirstBfcLine)
{
    auto cc0 = cleanPart();
    cc0.replace(cc0.find("Licensed under CC BY 4.0"), 24, "Marked with CC0 1.0");
    EXPECT_EQ(idsOf(cc0), Ids{});
    EXPECT_EQ(idsOf(cleanPart("Cylinder  1.0", "8\\4-4cyli.dat", "8_Primitive"), "4-4cyli.dat"), Ids{});
    EXPECT_EQ(idsOf(cleanPart("Cylinder  1.0", "48\\4-4cyli.dat", "8_Primitive"), "4-4cyli.dat"), Ids{"type.path"});
    EXPECT_EQ(idsOf(cleanPart("Brick  2 x  4", "3001.dat", "Part", "0 BFC INVERTNEXT\r\n")), Ids{})
        << "a body that starts with INVERTNEXT";
}

TEST(TrackerRules, RetiredCategoriesOnPartsOnlyNameTheirReplacement)
{
    const auto message = [](const std::string& description, const std::string& type = "Part") {
        for (const auto& f :
             CheckForTracker(cleanPart(description, "3001.dat", type), "3001.dat", Categories, Colours()))
            if (f.id == "warning.minifigcategory")
                return f.text;
        return std::string("none");
    };
    EXPECT_NE(message("Minifig Hat").find("use a suitable active Minifig category"), std::string::npos);
    EXPECT_NE(message("Forklift Arm", "Shortcut").find("use Vehicle"), std::string::npos);
    EXPECT_NE(message("Lever Small").find("no replacement"), std::string::npos);
    EXPECT_EQ(message("~Minifig Hat", "Subpart"), "none");
    EXPECT_EQ(message("Lever Small", "Primitive"), "none");
    EXPECT_EQ(message("minifig Hat"), "none") << "compared with its case";
}

TEST(TrackerRules, DescriptionNumbersAfterOneBlank)
{
    for (const auto* description : {"Brick 1 x 2", "Cone 18 x 0.25", "Brick  1 x 2"})
        EXPECT_TRUE(warns(description)) << description;
    for (const auto* description : {"Brick  1 x  2", "Tile 12 x 12", "Hose 3\"", "Wheel 3-Spoke", "Type 2 Ball",
                                    "Technic Ball Joint Type 2", "Brick with 1 White Stripe", "Tile 1/2"})
        EXPECT_FALSE(warns(description)) << description;
}

TEST(TrackerRules, PatternNamesAreSplitAsTheTrackerSplitsThem)
{
    for (const auto* base : {"3626bpx1", "973p37", "4073pc01", "3001p1234", "3001P01", "3001p01-f1"}) {
        const auto file = std::string(base) + ".dat";
        EXPECT_TRUE(idsOf(cleanPart("Brick with Stars", file), file).contains("description.patternword")) << base;
    }
    for (const auto* base : {"22385p026", "3002p18b", "3001p01c01", "3001c01"}) {
        const auto file = std::string(base) + ".dat";
        EXPECT_EQ(idsOf(cleanPart("Brick with Stars", file), file), Ids{}) << base;
    }
}

TEST(TrackerRules, HistoryUsersAndBlanks)
{
    const auto history = [](const std::string& line) { return idsOf(cleanPart("Brick", "3001.dat", "Part", line)); };
    EXPECT_EQ(history("0 !HISTORY\t2024-01-02  {Jane Doe}\tmade\r\n"), Ids{});
    EXPECT_EQ(history("0 !HISTORY 2024-01-02 [J.C. Tchang] made\r\n"), (Ids{"history.invalid", "line.invalid"}));
}

} // namespace
