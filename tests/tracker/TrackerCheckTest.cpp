// The Parts Tracker's header rules: for each family a header that passes and one that breaks it.
#include <gtest/gtest.h>

#include <set>

#include "TrackerCheck.h"

namespace {

const StringList Categories = {"<none>", "Brick", "Hose", "Technic", "Moved", "Obsolete", "Minifig Accessory"};

// A header the Tracker accepts, with the body line after it.
std::string cleanPart(const std::string& description = "Brick  2 x  4", const std::string& name = "3001.dat",
                      const std::string& type = "Part", const std::string& extra = "")
{
    return "0 " + description + "\r\n0 Name: " + name + "\r\n0 Author: Jane Doe [jdoe]\r\n0 !LDRAW_ORG " + type +
           "\r\n0 !LICENSE Licensed under CC BY 4.0 : see CAreadme.txt\r\n\r\n0 BFC CERTIFY CCW\r\n\r\n" + extra +
           "1 16 0 0 0 1 0 0 0 1 0 0 0 1 stud.dat\r\n";
}

std::set<std::string> idsOf(const std::string& text, const std::string& fileName = "3001.dat")
{
    std::set<std::string> ids;
    for (const auto& finding : CheckForTracker(text, fileName, Categories))
        ids.insert(finding.id);
    return ids;
}

using Ids = std::set<std::string>;

TEST(TrackerRules, AMissingOrMalformedHeaderLineStopsEveryOtherRule)
{
    auto text = cleanPart("Brick 1 x 2", "x3001.dat");
    text.replace(text.find("Jane Doe [jdoe]"), 15, "Jane [j d]");
    const auto findings = CheckForTracker(text, "x3001.dat", Categories);
    ASSERT_EQ(findings.size(), 1u);
    EXPECT_EQ(findings[0].id, "missing");
    EXPECT_EQ(findings[0].level, FindingLevel::Error);
    EXPECT_EQ(idsOf(cleanPart("Brick", "3001.dat", "Mystery")), Ids{"missing"});
    auto userOnly = cleanPart();
    userOnly.replace(userOnly.find("Jane Doe [jdoe]"), 15, "[jdoe]");
    EXPECT_EQ(idsOf(userOnly), Ids{});
}

TEST(TrackerRules, LicenceAndBfc)
{
    auto text = cleanPart();
    EXPECT_EQ(CheckForTracker(text, "3001.dat", Categories).size(), 0u);
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
    EXPECT_EQ(idsOf(cleanPart("Brick\t2")), Ids{"description.invalidchars"});
    EXPECT_EQ(idsOf(cleanPart("Brick 1 x 2")), Ids{"warning.descriptionnumbers"});
    EXPECT_EQ(idsOf(cleanPart("Technic Ball Joint Type 2")), Ids{});
    EXPECT_EQ(idsOf(cleanPart("Brick with 1 White Stripe")), Ids{}) << "before White";
}

TEST(TrackerRules, CategoriesAndObsoleteParts)
{
    EXPECT_EQ(idsOf(cleanPart("Brick", "3001.dat", "Part", "0 !CATEGORY Tyre\r\n")), Ids{"category.invalid"});
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
              Ids{"history.invalid"});
    EXPECT_EQ(idsOf(cleanPart("Brick", "3001.dat", "Part", "0 !HISTORY 2024-01-02 [jdoe]\r\n")),
              Ids{"history.invalid"});
    EXPECT_EQ(idsOf(cleanPart("Brick", "3001.dat", "Part", "0 !PREVIEW 16 0 0 0 1 1 0 0 1 0 0 0 1\r\n")),
              Ids{"warning.previewinvalid"});
    EXPECT_EQ(idsOf(cleanPart("Brick", "3001.dat", "Part", "1 16 0 0 0 1 0 0 0 1 0 0 0 1 3001.DAT\r\n")),
              Ids{"circularreference"});
}

} // namespace
