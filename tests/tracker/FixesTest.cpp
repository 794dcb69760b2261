// SPDX-License-Identifier: MIT
// The repairs of the Parts Tracker's findings: each number form, description, category and line,
// and what a repaired file holds afterwards.
#include <gtest/gtest.h>

#include "BodyFixes.h"
#include "Composer.h"
#include "NumberRewrite.h"
#include "ParseProgress.h"
#include "Parser.h"
#include "TrackerFixes.h"
#include "TrackerTestParts.h"

namespace {

using Notes = std::vector<std::string>;

TEST(NumberRewrite, EachNumberFormKeepsItsValue)
{
    for (const auto& [number, expected] : std::vector<std::pair<const char*, const char*>>{
             {"1.0", "1"}, {"-0.0", "0"}, {".500", ".5"}, {"2.50", "2.5"}, {".0", "0"}, {"10", "10"}, {"0", "0"}})
        EXPECT_EQ(WithoutTrailingZeros(number), expected) << number;
    for (const auto& [number, expected] : std::vector<std::pair<const char*, const char*>>{
             {"007", "7"}, {"-00.5", "-0.5"}, {"00", "0"}, {"010.50", "10.50"}, {"0.5", "0.5"}, {"-0", "-0"}})
        EXPECT_EQ(WithoutLeadingZeros(number), expected) << number;
    for (const auto& [number, expected] : std::vector<std::pair<const char*, const char*>>{{"1.0000005", "1"},
                                                                                           {"0.999999", "1"},
                                                                                           {"-9.999995", "-10"},
                                                                                           {".999999", "1"},
                                                                                           {"0.123455", "0.12346"},
                                                                                           {"-0.123455", "-0.12346"},
                                                                                           {"0.1234549", "0.12345"},
                                                                                           {"-0.000004", "0"},
                                                                                           {"1.12345", "1.12345"}})
        EXPECT_EQ(RoundedToFiveDecimals(number), expected) << number;
}

std::string fixedBody(std::string body, NumberFix fix, Notes* left = nullptr)
{
    const auto note = FixNumbers(body, fix, 1);
    if (left != nullptr)
        *left = note.left;
    return body;
}

TEST(BodyFixes, OnlyTheNumbersOfLinesWithTheFindingChange)
{
    EXPECT_EQ(fixedBody("3  16\t1.50  0 0 1 0 0 0 1 2.0\r\n2 24 1.0 0 0 1 0 0", NumberFix::TrailingZeros),
              "3  16\t1.5  0 0 1 0 0 0 1 2\r\n2 24 1 0 0 1 0 0")
        << "the blanks between the words stay, a number at the end of a line too";
    EXPECT_EQ(fixedBody("0 !: 3 16 1.0 0 0 1 0 0 0 1 0\r\n0 !TEXMAP END 1.0", NumberFix::TrailingZeros),
              "0 !: 3 16 1 0 0 1 0 0 0 1 0\r\n0 !TEXMAP END 1.0");
    Notes left;
    EXPECT_EQ(fixedBody("1 016 007 0 0 1 0 0 0 1 0 0 0 1 010.dat", NumberFix::LeadingZeros, &left),
              "1 016 7 0 0 1 0 0 0 1 0 0 0 1 010.dat");
    EXPECT_EQ(left, Notes{"line 1: the colour code \"016\" is kept as it is"});
    EXPECT_EQ(fixedBody("3 16 0.1234567 0 0 1 0 0 0 0.999999 1.0000005", NumberFix::DecimalPrecision),
              "3 16 0.12346 0 0 1 0 0 0 1 1");
    EXPECT_EQ(fixedBody("1 16 0 0 0 1 0 0 0 1 0 0 0 1 s\\1.123456.dat", NumberFix::DecimalPrecision, &left),
              "1 16 0 0 0 1 0 0 0 1 0 0 0 1 s\\1.123456.dat");
    EXPECT_EQ(left, Notes{"line 1: \"s\\1.123456.dat\" is no number of the line (it is in the file name)"});
}

TEST(BodyFixes, RoundingThatWouldBreakTheGeometryIsLeft)
{
    const std::string singular = "1 16 0 0 0 0.000001 0 0 0 1 0 0 0 1 stud.dat";
    const std::string concave = "4 16 0.000015 0.000012 0 0 0 0 0.00004 0 0 0.00004 0.00003 0";
    Notes left;
    EXPECT_EQ(fixedBody(singular + "\r\n" + concave, NumberFix::DecimalPrecision, &left), singular + "\r\n" + concave);
    EXPECT_EQ(left,
              (Notes{"line 1: rounding would make it line.singular", "line 2: rounding would make it line.notconvex"}));
}

TEST(BodyFixes, LinesAndOptionalLinesTakeTheEdgeColour)
{
    std::string body =
        "2 16 0 0 0 1 0 0\r\n5 0x2FF0000 0 0 0 1 0 0 0 1 0 1 1 0\r\n3 16 0 0 0 1 0 0 0 1 0\r\n2 24 0 0 0 1 0 0";
    EXPECT_EQ(FixLineColours(body, 1).fixed, 2);
    EXPECT_EQ(body, "2 24 0 0 0 1 0 0\r\n5 24 0 0 0 1 0 0 0 1 0 1 1 0\r\n3 16 0 0 0 1 0 0 0 1 0\r\n2 24 0 0 0 1 0 0");
}

struct Fixed {
    std::string text; // what the save writes
    Notes notes;
};

Fixed fixPart(std::string text, const std::string& fileName, std::set<std::string> chosen = DefaultFixIds(),
              bool limitDescription = true)
{
    HeaderData header;
    header.FilePath = "/lib/parts/" + fileName;
    ParseProgress progress;
    ParseHeaderText(header, std::move(text), progress);
    const FixContext context{{Categories, limitDescription, {2024, 5, 6, 12, 0, 0}}, Colours()};
    Fixed fixed;
    for (const auto& [id, note] : FixForTracker(header, chosen, context)) {
        if (note.fixed > 0)
            fixed.notes.push_back("fixed " + id + " " + std::to_string(note.fixed));
        for (const auto& why : note.left)
            fixed.notes.push_back("left " + id + ": " + why);
    }
    fixed.text = ComposeHeader(header) + header.Body + "\r\n";
    return fixed;
}

// The description line of a fixed clean part.
std::string fixedDescription(const std::string& description, const std::string& fileName = "3001.dat",
                             const std::string& extra = "")
{
    const auto text = fixPart(cleanPart(description, fileName, "Part", extra), fileName).text;
    return text.substr(2, text.find("\r\n") - 2);
}

TEST(HeaderFixes, DescriptionNumbersTakeASecondBlankWhereTheTrackerAsks)
{
    EXPECT_EQ(fixedDescription("Brick 1 x 2"), "Brick  1 x  2");
    EXPECT_EQ(fixedDescription("Technic Axle 2 Notched Type 2"), "Technic Axle  2 Notched Type 2");
    EXPECT_EQ(fixedDescription("Brick 1 x 2 Phase 1 with 2 Balls"), "Brick  1 x  2 Phase 1 with 2 Balls");
    EXPECT_EQ(fixedDescription("Hose 3\" with 1 Stripe 4"), "Hose 3\" with 1 Stripe  4");
    const std::string longest(60, 'B');
    const auto tooLong = fixPart(cleanPart(longest + " 1 x 2"), "3001.dat");
    EXPECT_EQ(tooLong.notes, (Notes{"left warning.descriptionnumbers: a second blank before each number would make "
                                    "the description longer than 64 characters"}));
    EXPECT_NE(
        fixPart(cleanPart(longest + " 1 x 2"), "3001.dat", DefaultFixIds(), false).text.find(longest + "  1 x  2"),
        std::string::npos)
        << "without the length limit";
}

TEST(HeaderFixes, RetiredCategoriesTakeTheirReplacementOrAreLeft)
{
    const auto category = [](const std::string& description, const std::string& extra = "") {
        const auto fixed = fixPart(cleanPart(description, "3001.dat", "Part", extra), "3001.dat");
        const auto at = fixed.text.find("0 !CATEGORY ");
        return at == std::string::npos ? fixed.notes.at(0)
                                       : fixed.text.substr(at + 12, fixed.text.find('\r', at) - at - 12);
    };
    EXPECT_EQ(category("Forklift Arm"), "Vehicle");
    EXPECT_EQ(category("Minifig Accessory Hat"), "Minifig Accessory");
    EXPECT_EQ(category("Technic Lever  3", "0 !CATEGORY Lever\r\n"), "Technic");
    EXPECT_EQ(category("Minifig Accessoryx Hat"),
              "left warning.minifigcategory: the category Minifig needs a category chosen by hand");
    for (const auto* retired : {"Pov-RAY Logo", "Grab Jaw", "Lever Small"})
        EXPECT_EQ(category(retired).find("left warning.minifigcategory: "), 0u) << retired;
}

TEST(HeaderFixes, LicenceNameFolderAndPatternWord)
{
    auto old = cleanPart("Brick with Stars", "3001p01.dat", "Part", "0 !KEYWORDS Set 6080\r\n");
    old.replace(old.find("Licensed under CC BY 4.0"), 24, "Redistributable under CCAL version 2.0");
    const auto fixed = fixPart(old, "3001p01.dat");
    EXPECT_NE(fixed.text.find("0 Brick with Stars Pattern\r\n"), std::string::npos);
    EXPECT_NE(fixed.text.find("0 !LICENSE Licensed under CC BY 2.0 and CC BY 4.0 : see CAreadme.txt\r\n"),
              std::string::npos);
    EXPECT_EQ(fixed.notes, (Notes{"fixed license.approved 1", "fixed description.patternword 1"}));
    EXPECT_NE(
        fixPart(cleanPart("~Brick Sub", "3001s01.dat", "Subpart"), "3001s01.dat").text.find("0 Name: s\\3001s01.dat"),
        std::string::npos);
    const auto xName = fixPart(cleanPart("Brick", "s\\3001.dat"), "x3001.dat");
    EXPECT_NE(xName.text.find("0 Name: s\\3001.dat\r\n"), std::string::npos);
    EXPECT_EQ(xName.notes, Notes{"left type.path: fixing it would bring name.xparts"});
    EXPECT_NE(fixPart(cleanPart("Brick", "3001.dat", "Part", "2 16 0 0 0 1 0 0\r\n"), "3001.dat").text.find("2 16 "),
              std::string::npos)
        << "lines keep their colour unless asked";
}

TEST(TrackerFixes, AFixedFileHasNoneOfTheFixedFindingsNoNewOneAndStaysAsItIs)
{
    auto old = cleanPart("Minifig Hat 1 x 2", "3001s01.dat", "Subpart",
                         "2 16 0 0 0 1.0 0 0\r\n3 16 007 0 0 1 0 0 0 1.1234567 0\r\n");
    old.replace(old.find("Licensed under CC BY 4.0"), 24, "Redistributable under CCAL version 2.0");
    const auto before = idsOf(old, "3001s01.dat");
    const auto fixed = fixPart(old, "3001s01.dat",
                               {"license.approved", "type.path", "numbers.trailingzeros", "numbers.decimalprecision",
                                "line.invalidcoloredlines"});
    EXPECT_EQ(before, (Ids{"license.approved", "type.path", "description.subpartdesc", "warning.descriptionnumbers",
                           "numbers.trailingzeros", "numbers.leadingzeros", "numbers.decimalprecision",
                           "line.invalidcoloredlines"}));
    EXPECT_EQ(idsOf(fixed.text, "3001s01.dat"),
              (Ids{"description.subpartdesc", "warning.descriptionnumbers", "numbers.leadingzeros"}));
    const auto again = fixPart(fixed.text, "3001s01.dat",
                               {"license.approved", "type.path", "numbers.trailingzeros", "numbers.decimalprecision",
                                "line.invalidcoloredlines"});
    EXPECT_EQ(again.text, fixed.text);
    EXPECT_EQ(again.notes, Notes{});
}

} // namespace
