// SPDX-License-Identifier: MIT
// The Parts Tracker's rules on a part's lines: for each family, lines that pass and lines that fail.
#include <gtest/gtest.h>

#include "ColourCodes.h"
#include "TrackerTestParts.h"

namespace {

using L = LineIds;
const std::string Triangle = "3 16 0 0 0 1 0 0 0 1 0\r\n";

// The ids found on the first body line alone.
Ids onLine(const std::string& line, const ColourCodes& colours = Colours())
{
    Ids ids;
    for (const auto& [number, id] : bodyFindings(line + "\r\n", colours))
        if (number == 1)
            ids.insert(id);
    return ids;
}

TEST(LineShapes, GeometryLinesHaveTheirTypesNumbersAndColours)
{
    for (const auto* line : {"2 24 0 0 0 1 0 0", "3 16 0 0 0 1 0 0 0 1 0", "4  16 0 0 0 1 0 0 1 1 0 0  1 0",
                             "3\t16  .5 -.5 0 1 0 0\xC2\xA0\xC2\xA0"
                             "0 1 0",
                             "4 16 0 0 0 1 0 0 1 1 0 0 1 0", "5 24 0 0 0 1 0 0 0 1 0 1 1 0",
                             "3 0x2FF0000 0 0 0 1 0 0 0 1 0", "1 16 0 0 0 1 0 0 0 1 0 0 0 1 s\\3001s01.dat",
                             "1 16 0 0 0 1 0 0 0 1 0 0 0 1x.dat", "1 16 0 0 0 1 0 0 0 1 0 0 0 1 a01 b.dat"})
        EXPECT_EQ(onLine(line), Ids{}) << line;
    for (const auto* line :
         {"3 16 0 0 0 1 0 0 0 1", "3 16 0 0 0 1 0 0 0 1 0 7", "3 16 +5 0 0 1 0 0 0 1 0", "3 16 5. 0 0 1 0 0 0 1 0",
          "3 16 1e3 0 0 1 0 0 0 1 0", "3 16 1,5 0 0 1 0 0 0 1 0", "3 0X2FF0000 0 0 0 1 0 0 0 1 0",
          "3 0x2FF000 0 0 0 1 0 0 0 1 0", "1 16 0 0 0 1 0 0 0 1 0 0 0 1", "6 16 0 0 0", "3x16 0 0 0 1 0 0 0 1 0"})
        EXPECT_EQ(onLine(line), Ids{"line.invalid"}) << line;
}

TEST(LineShapes, MetaLinesHaveTheShapeTheirWordAsks)
{
    for (const auto* line :
         {"0 // a comment", "0 BFC INVERTNEXT", "0 BFC CLIP CW", "0 BFC nocertify", "0 !: 3 16 0 0 0 1 0 0 0 1 0",
          "0 !TEXMAP START PLANAR 0 0 0 1 0 0 0 1 0 a.png", "0 !TEXMAP END", "0 !HELP use it", "0 Name: 3001.dat",
          "0 !HISTORY 2024-01-02 {Jo} x", "0", "0 //", "0 !COLOUR Red CODE 4 VALUE #C91A09 EDGE #333333",
          "0 !COLOUR Chrome_Silver CODE 383 VALUE 0xE0E0E0 EDGE #A4A4A4 ALPHA 255 CHROME METAL",
          "0 !COLOUR Glitter CODE 114 VALUE #DF6695 EDGE #9A2A66 ALPHA 128 MATERIAL GLITTER VALUE #FFFFFF "
          "FRACTION 0.17 VFRACTION 0.2 SIZE 1",
          "0 !COLOUR Speckle CODE 132 VALUE #000000 EDGE #898788 MATERIAL SPECKLE FRACTION 1.00 MINSIZE .5 MAXSIZE 3",
          "0 !AVATAR CATEGORY \"Figure\" DESCRIPTION \"A man\" PART 0 -1.5 0 1 0 0 0 1 0 \"3626.dat\""})
        EXPECT_EQ(onLine(line), Ids{}) << line;
    for (const auto* line : {"0 a comment without slashes",
                             "0 //comment",
                             "0 bfc certify",
                             "0 BFC certify ccw",
                             "0 BFC CCW CLIP",
                             "0 !:3 16 0 0 0 1 0 0 0 1 0",
                             "0 !: 0 // inside",
                             "0 !LDCAD GROUP",
                             "0 WRITE hello",
                             "0 !HELP",
                             "0 Name: a b",
                             "0 !TEXMAP BEGIN",
                             "0 !PREVIEW 16 0 0",
                             "x",
                             "0 !COLOUR Red CODE 4 VALUE #C91A09 EDGE #333333 ALPHA 256",
                             "0 !COLOUR Red-2 CODE 4 VALUE #C91A09 EDGE #333333",
                             "0 !COLOUR Red CODE 4 VALUE #C91A09 EDGE #333333 MATERIAL GLITTER FRACTION 1.5",
                             "0 !COLOUR Red CODE 4 VALUE #C91A09 EDGE #333333 MATERIAL SPECKLE MINSIZE 1",
                             "0 !COLOUR Red CODE 4 VALUE #C91A09 EDGE #333333 MATERIAL PLASTIC",
                             "0 !AVATAR CATEGORY \"Figure\" DESCRIPTION \"A man\" PART .5 0 0 1 0 0 0 1 0 \"a.dat\"",
                             "0 !AVATAR CATEGORY \"Figure\" DESCRIPTION \"A man\" PART 0 0 1 0 0 0 1 0 \"a.dat\"",
                             "\xC2\xA0"
                             "0 // nbsp first"})
        EXPECT_EQ(onLine(line), Ids{"line.invalid"}) << line;
    // After the header, where a second author line does not replace the first.
    EXPECT_EQ(bodyFindings("1 16 0 0 0 1 0 0 0 1 0 0 0 1 stud.dat\r\n0 Author: Jo [j d]\r\n"),
              (L{{2, "line.invalid"}}));
}

TEST(LineShapes, LineNumbersCountTheCheckedTextsLines)
{
    EXPECT_EQ(bodyFindings("0 bad\r\n\r\n0 //\r\n0 bad\n0 bad\r0 bad\r\n"),
              (L{{1, "line.invalid"}, {4, "line.invalid"}, {5, "line.invalid"}, {6, "line.invalid"}}));
    const auto noHeader = CheckForTracker("0 any words here\r\n0 bad\r\n", "3001.dat", Categories, Colours());
    ASSERT_FALSE(noHeader.empty());
    for (const auto& finding : noHeader)
        EXPECT_EQ(finding.id, "missing") << "nothing else runs without the header";
}

TEST(NumberFormats, DecimalsTrailingAndLeadingZeros)
{
    EXPECT_EQ(onLine("3 16 0.12345 0 0 1 0 0 0 1 0"), Ids{});
    EXPECT_EQ(onLine("3 16 0.123456 0 0 1 0 0 0 1 0"), Ids{"numbers.decimalprecision"});
    EXPECT_EQ(onLine("3 16 0.12345 0 0 1.123456 0 0 0 1 0"), Ids{}) << "only the first long fraction counts";
    EXPECT_EQ(onLine("3 16 1.05 10 100 1 0 0 0 0.5 0"), Ids{});
    EXPECT_EQ(onLine("3 16 2.0 0 0 1 0 0 0 1 0"), Ids{"numbers.trailingzeros"});
    EXPECT_EQ(onLine("3 16 0 0 0 1 0 0 0 1 0.000"), Ids{"numbers.trailingzeros"});
    EXPECT_EQ(onLine("3 16 0.5 0 0 -0.5 0 0 0 2 0"), Ids{});
    EXPECT_EQ(onLine("3 16 01 0 0 0 0 0 0 2 0"), Ids{"numbers.leadingzeros"});
    EXPECT_EQ(onLine("3 016 -00.5 0 0 0 0 0 0 2 0"), Ids{"numbers.leadingzeros"});
    EXPECT_EQ(onLine("3 16 0 0 0 1 0 0 0 2 010"), Ids{}) << "the last word is never examined";
    EXPECT_EQ(onLine("0 !: 3 16 0.123456 0 0 1 0 0 0 1 0"), Ids{"numbers.decimalprecision"});
}

TEST(Colours, CodesComeFromTheValidColourLinesOfAnLDConfig)
{
    const auto ldconfig = ReadLDConfig("0 LDraw.org Configuration File\r\n"
                                       "0 !COLOUR Black  CODE   0 VALUE #1B2A34 EDGE #808080\r\n"
                                       "0 !COLOUR Main_Colour CODE 16 VALUE #FFFF80 EDGE #333333\r\n"
                                       "0 !COLOUR Edge_Colour CODE 24 VALUE #7F7F7F EDGE 0\r\n"
                                       "0 !COLOUR Trans_Red CODE 36 VALUE #C91A09 EDGE #333333 ALPHA 128\r\n"
                                       "0 !COLOUR Short CODE 5 VALUE #C91A0 EDGE #333333\r\n");
    ASSERT_TRUE(ldconfig.has_value());
    EXPECT_EQ(ldconfig->size(), 4u);
    EXPECT_EQ(onLine("3 36 0 0 0 1 0 0 0 1 0", *ldconfig), Ids{});
    EXPECT_EQ(onLine("3 0x2FF0000 0 0 0 1 0 0 0 1 0", *ldconfig), Ids{});
    EXPECT_EQ(onLine("3 5 0 0 0 1 0 0 0 1 0", *ldconfig), Ids{"line.invalidcolor"});
    EXPECT_EQ(onLine("1 24 0 0 0 1 0 0 0 1 0 0 0 1 stud.dat", *ldconfig), Ids{"line.invalidcolor"});
    EXPECT_EQ(onLine("3 24 0 0 0 1 0 0 0 1 0", *ldconfig), Ids{"line.invalidcolor24"});
    EXPECT_EQ(onLine("2 16 0 0 0 1 0 0", *ldconfig), Ids{"line.invalidcoloredlines"});
    EXPECT_EQ(onLine("5 0x2FF0000 0 0 0 1 0 0 0 1 0 1 1 0", *ldconfig), Ids{"line.invalidcoloredlines"});
    EXPECT_EQ(bodyFindings("1 24 0 0 0 1 0 0 0 1 0 0 0 1 stud.dat\r\n", *ldconfig).size(), 1u);
    EXPECT_FALSE(ReadLDConfig("0 !COLOUR Red CODE 4 VALUE #C91A09\r\n").has_value()) << "EDGE is required";
}

TEST(Matrix, APlacementMustNotBeSingular)
{
    EXPECT_EQ(onLine("1 16 0 0 0 0 0 1 0 1 0 -1 0 0 stud.dat"), Ids{});
    EXPECT_EQ(onLine("1 16 0 0 0 1 0 0 0 0 0 0 0 1 stud.dat"), Ids{"line.singular"});
    EXPECT_EQ(onLine("1 16 0 0 0 .0003 0 0 0 .0003 0 0 0 .0003 stud.dat"), Ids{});
    EXPECT_EQ(onLine("1 16 0 0 0 .0002 0 0 0 .0002 0 0 0 .0002 stud.dat"), Ids{"line.singular"});
    EXPECT_EQ(onLine("1 16 0 0 0 -1 0 0 0 1 0 0 0 1 stud.dat"), Ids{}) << "a mirror is no singular placement";
}

TEST(Points, IdenticalColinearConvexAndFlat)
{
    EXPECT_EQ(onLine("3 16 0 0 0 1 0 0 1.0 0 0"), (Ids{"line.identicalpoints", "numbers.trailingzeros"}));
    EXPECT_EQ(onLine("4 16 0 0 0 1 0 0 0 0 0 0 1 0"), Ids{"line.identicalpoints"}) << "points 1 and 3";
    EXPECT_EQ(onLine("2 24 0 0 0 -0 0 0"), Ids{"line.identicalpoints"});
    EXPECT_EQ(onLine("5 24 0 0 0 1 0 0 1 1 0 1 1 0"), Ids{"line.identicalpoints"}) << "the control points";
    EXPECT_EQ(onLine("3 16 0 0 0 1 0 0 2 0.002 0"), Ids{}) << "179.885 degrees";
    EXPECT_EQ(onLine("3 16 0 0 0 1 0 0 2 0.001 0"), Ids{"line.colinear"}) << "179.943 degrees";
    EXPECT_EQ(onLine("3 16 0 0 0 1000 0 0 1000 0.3 0"), Ids{"line.colinear"}) << "0.0172 degrees";
    EXPECT_EQ(onLine("3 16 0 0 0 1 0 0 2 0 0"), Ids{"line.colinear"}) << "exactly on one line";
    EXPECT_EQ(onLine("4 16 0 0 0 1 0 0 2 0 0 0 1 0"), Ids{"line.colinear"});
    EXPECT_EQ(onLine("4 16 0 0 0 1 0 0 1 1 0 0 1 0"), Ids{});
    EXPECT_EQ(onLine("4 16 0 0 0 1 0 0 0 1 0 1 1 0"), Ids{"line.notconvex"}) << "bow-tie";
    EXPECT_EQ(onLine("4 16 0 0 0 2 0 0 0.5 0.5 0 0 2 0"), Ids{"line.notconvex"}) << "dart";
    EXPECT_EQ(onLine("4 16 0 0 0 1 0 0 1 1 0.01 0 1 0"), Ids{}) << "0.81 degrees";
    EXPECT_EQ(onLine("4 16 0 0 0 1 0 0 1 1 0.03 0 1 0"), Ids{"warning.notcoplaner"}) << "2.43 degrees";
    EXPECT_EQ(onLine("4 16 0 0 0 1 0 0 1 1 0.04 0 1 0"), Ids{"line.notcoplaner"}) << "3.24 degrees";
    EXPECT_EQ(onLine("4 16 0 0 0 1 0 0 1 1 0.1 0 1 0"), Ids{"line.notcoplaner"}) << "8.07 degrees";
}

TEST(StickerColour, AStickerShortcutPlacesItsStickersInColour16)
{
    const auto sticker = [](const std::string& type, const std::string& line) {
        return idsOf(cleanPart("Sticker  1 x  2", "3999.dat", type, "0 !CATEGORY Sticker Shortcut\r\n" + line + "\r\n"),
                     "3999.dat");
    };
    EXPECT_EQ(sticker("Shortcut", "1 16 0 0 0 1 0 0 0 1 0 0 0 1 3999s01.dat"), Ids{});
    EXPECT_EQ(sticker("Unofficial_Shortcut", "1 4 0 0 0 1 0 0 0 1 0 0 0 1 3999s01.dat"), Ids{"warning.stickercolor"});
    EXPECT_EQ(sticker("Shortcut", "1 0x2FF0000 0 0 0 1 0 0 0 1 0 0 0 1 3999s01.dat"), Ids{"warning.stickercolor"});
}

TEST(SelfReference, ThePartsNameAsWrittenAgainstLowerCasedFiles)
{
    EXPECT_EQ(idsOf(cleanPart("Brick", "3001.dat", "Part", "1 16 0 0 0 1 0 0 0 1 0 0 0 1 3001.DAT\r\n")),
              Ids{"circularreference"});
    EXPECT_EQ(idsOf(cleanPart("Brick", "3001.dat", "Part", "0 !: 1 16 0 0 0 1 0 0 0 1 0 0 0 1 3001.dat\r\n")), Ids{});
}

} // namespace
