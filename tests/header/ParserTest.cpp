// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "Composer.h"
#include "FileSave.h"
#include "ParseProgress.h"
#include "Parser.h"
#include "ScriptedDialogs.h"
#include "TextFile.h"

namespace {

HeaderData parseText(const std::string& text)
{
    HeaderData header;
    ScriptedDialogs dialogs;
    ParseProgress progress;
    ParsePartFileContent(header, text, dialogs, progress);
    return header;
}

// Parses lines joined by CR LF, as a CR LF part file holds them.
HeaderData parseLines(std::initializer_list<std::string> lines)
{
    std::string text;
    for (const auto& line : lines)
        text += line + "\r\n";
    return parseText(text);
}

TEST(ParserDescription, FirstLineWithoutItsZeroIsTheDescription)
{
    EXPECT_EQ(parseLines({"0 Brick 2 x 4"}).PartDescription, "Brick 2 x 4");
    EXPECT_EQ(parseLines({"0  Brick"}).PartDescription, " Brick");
    EXPECT_EQ(parseLines({"0"}).PartDescription, "");
    EXPECT_EQ(parseLines({"0 "}).PartDescription, "");
    EXPECT_EQ(parseLines({"0 Name: 3001.dat"}).PartDescription, "Name: 3001.dat");
    const auto emptyFirstLine = parseLines({"", "0 Brick 2 x 4"});
    EXPECT_EQ(emptyFirstLine.PartDescription, "");
    EXPECT_EQ(emptyFirstLine.Body, "0 Brick 2 x 4");
}

TEST(ParserDescription, NeedsWorkInAnyCaseAndOrder)
{
    EXPECT_TRUE(parseLines({"0 Brick (Needs Work)"}).NeedsWork);
    EXPECT_TRUE(parseLines({"0 Brick needswork"}).NeedsWork);
    EXPECT_TRUE(parseLines({"0 Brick work needed"}).NeedsWork);
    EXPECT_FALSE(parseLines({"0 Brick needs care"}).NeedsWork);
    EXPECT_FALSE(parseLines({"1 16 0 0 0 1 0 0 0 1 0 0 0 1 needs work.dat"}).NeedsWork);
}

TEST(ParserRows, NameIsWordThreeLowerCased)
{
    EXPECT_EQ(parseLines({"0 d", "0 Name: 3001.DAT"}).PartName, "3001.dat");
    EXPECT_EQ(parseLines({"0 d", "0 Name: my part.dat"}).PartName, "my");
}

TEST(ParserRows, AuthorNameAndUserName)
{
    auto h = parseLines({"0 d", "0 Author: Jane Doe [jdoe]"});
    EXPECT_EQ(h.ParsedRealName, "Jane Doe");
    EXPECT_EQ(h.AuthorUserName, "jdoe");
    h = parseLines({"0 d", "0 Author: Jane <jane@example.org>"});
    EXPECT_EQ(h.AuthorUserName, "jane");
    h = parseLines({"0 d", "0 Author: Jane [Doe Smith]"});
    EXPECT_EQ(h.ParsedRealName, "Jane Smith]");
    EXPECT_EQ(h.AuthorUserName, "Do");
    h = parseLines({"0 d", "0 Author: [jdoe] Jane"});
    EXPECT_EQ(h.ParsedRealName, "[jdoe] Jane");
    h = parseLines({"0 d", "0 Author: Jane [x]"});
    EXPECT_EQ(h.AuthorUserName, "x");
    h = parseLines({"0 d", "0 Author: Jane []"});
    EXPECT_EQ(h.AuthorUserName, "");
}

TEST(ParserRows, BfcStatements)
{
    EXPECT_EQ(parseLines({"0 d", "0 BFC CERTIFY CCW"}).Bfc, "CERTIFY CCW");
    EXPECT_EQ(parseLines({"0 d", "0 BFC CERTIFY"}).Bfc, "");
    EXPECT_EQ(parseLines({"0 d", "0 BFC CERTIFY CCW", "0 BFC NOCLIP"}).Bfc, "NOCLIP");
    EXPECT_EQ(parseLines({"0 d", "0 BFC CERTIFY  CCW"}).Bfc, "CERTIFY  CCW");
    EXPECT_EQ(parseLines({"0 d", "0 BFC NOCERTIFY"}).Bfc, "NOCERTIFY");
}

TEST(ParserRows, InvertNextEndsTheHeader)
{
    for (const std::string invert : {"0 BFC INVERTNEXT", "0 BFC CERTIFY INVERTNEXT"}) {
        const auto h = parseLines({"0 d", invert, "0 !KEYWORDS x", "1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat"});
        EXPECT_TRUE(h.Keywords.empty());
        EXPECT_EQ(h.Body, invert + "\r\n0 !KEYWORDS x\r\n1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat");
        EXPECT_EQ(h.OldHeader, "0 d\r\n" + invert);
    }
}

TEST(ParserRows, PartTypeAndUpdateTag)
{
    auto h = parseLines({"0 d", "0 !LDRAW_ORG Part UPDATE 2004-01"});
    EXPECT_EQ(h.PartType, "Part");
    EXPECT_EQ(h.UpdateTag, "2004-01");
    EXPECT_EQ(parseLines({"0 d", "0 !LDRAW_ORG Part EXTRA"}).PartType, "Part EXTRA");
    EXPECT_EQ(parseLines({"0 d", "0 LDRAW_ORG Part Alias UPDATE 2003-02 x"}).PartType, "Part Alias");
    h = parseLines({"0 d", "0 !LDRAW_ORG Part UPDATE"});
    EXPECT_EQ(h.PartType, "Part");
    EXPECT_EQ(h.UpdateTag, "");
    EXPECT_EQ(parseLines({"0 d", "0 Unofficial Element"}).PartType, "Unofficial_Part");
    EXPECT_EQ(parseLines({"0 d", "0 UNOFFICIAL subpart"}).PartType, "Unofficial_Subpart");
    EXPECT_EQ(parseLines({"0 d", "0 Unofficial PART"}).PartType, "");
    EXPECT_EQ(parseLines({"0 d", "0 Original LDraw Part"}).PartType, "Part");
    EXPECT_EQ(parseLines({"0 d", "0 Original LDraw"}).PartType, "");
}

TEST(ParserRows, ListLinesKeepTheirWordsJoined)
{
    const auto h = parseLines({"0 d", "0 !KEYWORDS a,  b", "0 KEYWORDS c", "0 !HELP  x", "0 !CMDLINE -c4",
                               "0 !CATEGORY Minifig Accessory",
                               "0 !LICENSE Redistributable under CCAL version 2.0 : see CAreadme.txt",
                               "0 !HISTORY 12.3.2004 text", "0 COLOR 4  red"});
    EXPECT_EQ(h.Keywords, (EntryList{"a,  b", "c"}));
    EXPECT_EQ(h.Category, "Minifig Accessory");
    EXPECT_EQ(h.HelpLines, (EntryList{"x"}));
    EXPECT_EQ(h.CmdLines, (EntryList{"-c4"}));
    EXPECT_EQ(h.License, "Redistributable under CCAL version 2.0 : see CAreadme.txt");
    EXPECT_EQ(h.History, (EntryList{"12.3.2004 text"}));
    EXPECT_EQ(h.ColorLines, (EntryList{"0 COLOR 4  red"}));
}

TEST(ParserRows, CommentsAndDatedLines)
{
    const auto h = parseLines({"0 d", "0 // 2004-03-12 [jdoe] fixed   ", "0 // fixed it   ", "0 //fixed it",
                               "0 2004-3-2 [jdoe] old style", "0 // 2004-03-12"});
    // Blanks at the end are dropped, all of them: a save writes what the next open reads alike.
    EXPECT_EQ(h.History, (EntryList{"2004-03-12 [jdoe] fixed", "2004-03-02 [jdoe] old style", "2004-03-12"}));
    EXPECT_EQ(h.Comments, (EntryList{"// fixed it"}));
    EXPECT_EQ(h.Body, "0 //fixed it");
}

TEST(ParserRows, FormsThatAreNotKeywordsStayInTheBody)
{
    const auto h = parseLines(
        {"0 d", "0 HELP me", "0 Category Brick", "0 !COLOR x y", "0 ROTATION CENTER 0 0 0", "0 CATEGORY Brick"});
    EXPECT_EQ(h.Body, "0 HELP me\r\n0 Category Brick\r\n0 !COLOR x y\r\n0 ROTATION CENTER 0 0 0");
    EXPECT_EQ(h.Category, "Brick");
}

TEST(ParserDates, OnlyRealDaysInYearMonthDayForm)
{
    const auto history = [](const std::string& word) { return parseLines({"0 d", "0 " + word + " x"}).History; };
    EXPECT_EQ(history("2004-02-29"), (EntryList{"2004-02-29 x"}));
    EXPECT_TRUE(history("2003-02-29").empty());
    EXPECT_TRUE(history("1900-02-29").empty());
    EXPECT_EQ(history("2000-2-29"), (EntryList{"2000-02-29 x"}));
    EXPECT_TRUE(history("2004-13-01").empty());
    EXPECT_TRUE(history("04-03-12").empty());
    EXPECT_TRUE(history("2004-003-12").empty());
    EXPECT_TRUE(history("12.3.2004").empty());
    EXPECT_TRUE(history("0000-01-01").empty());
    EXPECT_TRUE(history("2002-2-28:").empty());
}

TEST(ParserTwoWordLines, UnknownWordGoesToTheBodyKnownKeywordIsDropped)
{
    const auto h = parseLines({"0 d", "0 STEP", "0 Torso", "0 //", "0 Name:", "0 !KEYWORDS ", "0 !HELP", "0",
                               "0 2004-03-12", "1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat", "0 STEP"});
    EXPECT_EQ(h.Body, "0 STEP\r\n0 Torso\r\n1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat\r\n0 STEP");
    EXPECT_EQ(h.History, (EntryList{"2004-03-12"}));
    EXPECT_TRUE(h.Keywords.empty());
    EXPECT_EQ(h.PartName, "");
}

TEST(ParserBlanks, EmptyWordsAndLeadingBlanks)
{
    // Two blanks after the 0 give an empty word 2: no keyword matches, and no date.
    auto h = parseLines({"0 d", "0  Name: x"});
    EXPECT_EQ(h.PartName, "");
    EXPECT_EQ(h.Body, "0  Name: x");
    h = parseLines({"0 d", " 0 // text", "0 !KEYWORDS late"});
    EXPECT_EQ(h.Body, "0 // text\r\n0 !KEYWORDS late");
    EXPECT_TRUE(h.Keywords.empty());
    h = parseLines({"0 d", "0\tBFC CERTIFY CCW"});
    EXPECT_EQ(h.Bfc, "");
    EXPECT_EQ(h.Body, "0\tBFC CERTIFY CCW");
}

TEST(ParserEndOfHeader, BodyLinesAreTrimmedAndJoinedByCrLfKeepingInnerEmptyLines)
{
    const auto h =
        parseLines({"0 d", "", "0 FOO bar", "   1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat   ", "", "2 24 0 0 0 1 1 1"});
    EXPECT_EQ(h.Body, "0 FOO bar\r\n1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat\r\n\r\n2 24 0 0 0 1 1 1");
    EXPECT_EQ(h.OldHeader, "0 d\r\n0 FOO bar");
    EXPECT_EQ(parseText("0 d\r\n1 a\r\n 2 b \r\n3 c\r4 d\r\n\r\n  \r\n5 e").Body,
              "1 a\r\n2 b\r\n3 c\r\n4 d\r\n\r\n\r\n5 e");
    // Empty lines before any body line add nothing.
    EXPECT_EQ(parseText("0 d\r\n \r\n\r\n1 a\r\n").Body, "1 a");
    EXPECT_EQ(parseText("0 d\r\n   \r\n").Body, "");
    const auto noHeader = parseLines({"1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat"});
    EXPECT_EQ(noHeader.Body, "1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat");
    EXPECT_EQ(noHeader.PartDescription, "");
}

TEST(ParserRecord, ASecondParseStartsFromEmptyLists)
{
    HeaderData h;
    ScriptedDialogs dialogs;
    ParseProgress progress;
    ParsePartFileContent(h, "0 a\r\n0 !KEYWORDS k\r\n0 // c\r\n1 x\r\n", dialogs, progress);
    ParsePartFileContent(h, "0 b\r\n", dialogs, progress);
    EXPECT_TRUE(h.Keywords.empty());
    EXPECT_TRUE(h.Comments.empty());
    EXPECT_EQ(h.Body, "");
    EXPECT_EQ(h.OldHeader, "0 b");
}

// A NUL byte near the start marks a binary file, which is refused; any other byte is text.
TEST(ParserAnyInput, OddBytesAreJustTextButBinaryFilesAreRefused)
{
    EXPECT_EQ(parseLines({"0 \xff\x01\x7f"}).PartDescription, "\xff\x01\x7f");
    HeaderData binary;
    binary.FilePath = "/parts/picture.dat";
    ScriptedDialogs dialogs;
    ParseProgress progress;
    try {
        ParsePartFileContent(binary, std::string("0 d\r\n\0\x89PNG", 10), dialogs, progress);
        ADD_FAILURE() << "a file with a NUL byte was parsed";
    } catch (const NotTextFileError& refused) {
        EXPECT_STREQ(refused.what(), "/parts/picture.dat is not an LDraw text file.");
    }
    const std::string lateNul = "0 d\r\n0 // " + std::string(64 * 1024, 'x') + std::string(1, '\0');
    EXPECT_THROW(parseText(lateNul), NotTextFileError) << "a NUL beyond the first 64 KiB refuses the file too";
    const auto blanks = parseLines({"0 d", "0 !KEYWORDS" + std::string(100000, ' ') + "x"});
    EXPECT_EQ(blanks.Keywords, (EntryList{"x"})) << "empty words before the first word are skipped";
    const auto longLine = parseLines({"0 d", "1" + std::string(10 * 1024 * 1024, 'x')});
    EXPECT_EQ(longLine.Body.size(), 10u * 1024 * 1024 + 1);
}

// What a save writes must read back as written, or a file changes with every save (or the next
// save is refused). Each line here once made a second save differ from the first.
TEST(ParserSavedTwice, OddlySpacedLinesReadBackAsTheyWereSaved)
{
    const auto opened = [](const std::string& text) {
        HeaderData header;
        header.PartName = "n.dat"; // as opening the file sets it
        ScriptedDialogs dialogs;
        ParseProgress progress;
        ParsePartFileContent(header, text, dialogs, progress);
        header.AuthorRealName = header.ParsedRealName;
        return header;
    };
    const auto saved = [](const HeaderData& header) { return SavedText(header, ComposeHeader(header)); };
    for (const std::string odd :
         {"0 Author: Jane Doe   ", "0 !LDRAW_ORG Part  ", "0 !CMDLINE  ", "0 //  ", "0 !KEYWORDS   ", "0 Name:  x",
          "0 BFC  INVERTNEXT", "0 BFC  CERTIFY", "0 2004-1-1", "0 // 2004-02-02 "}) {
        const auto first = opened("0 d\r\n0 BFC CERTIFY CCW\r\n" + odd + "\r\n1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat\r\n");
        const auto second = opened(saved(first));
        EXPECT_EQ(saved(second), saved(first)) << odd;
        EXPECT_EQ(second.Bfc, first.Bfc) << odd;
    }
}

} // namespace
