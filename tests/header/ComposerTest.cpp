// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "Composer.h"

namespace {

TEST(Composer, EmptyRecordGivesFourLinesAndAUserNameAloneNoAuthor)
{
    HeaderData h;
    EXPECT_EQ(ComposeHeader(h), "0 \r\n0 Name: \r\n0 Author: Unknown\r\n\r\n");
    h.AuthorUserName = "jdoe";
    EXPECT_EQ(ComposeHeader(h), "0 \r\n0 Name: \r\n0 Author: Unknown\r\n\r\n");
}

TEST(Composer, ExampleHeaderInItsLineOrder)
{
    HeaderData h;
    h.PartDescription = "Brick 2 x 4";
    h.PartName = "3001.dat";
    h.AuthorRealName = "Sam Sample";
    h.AuthorUserName = "ssample";
    h.PartType = "Part";
    h.UpdateTag = "2004-01";
    h.Bfc = "CERTIFY CCW";
    h.Category = "Brick";
    h.Keywords = {"brick, stud", "2 x 4"};
    EXPECT_EQ(ComposeHeader(h), "0 Brick 2 x 4\r\n0 Name: 3001.dat\r\n0 Author: Sam Sample [ssample]\r\n"
                                "0 !LDRAW_ORG Part UPDATE 2004-01\r\n\r\n0 BFC CERTIFY CCW\r\n\r\n"
                                "0 !CATEGORY Brick\r\n0 !KEYWORDS brick, stud\r\n0 !KEYWORDS 2 x 4\r\n\r\n");
    // "<none>" writes no category line, and the keywords keep their group.
    h.Category = "<none>";
    EXPECT_NE(ComposeHeader(h).find("0 BFC CERTIFY CCW\r\n\r\n0 !KEYWORDS brick, stud\r\n"), std::string::npos);
    h.Keywords.clear();
    EXPECT_EQ(ComposeHeader(h).find("CERTIFY CCW\r\n\r\n\r\n"), std::string::npos);
}

TEST(Composer, EveryGroupFollowedByOneBlankLineAndColourLinesLast)
{
    HeaderData h;
    h.License = "L";
    h.HelpLines = {"h1", ""};
    h.Category = "Brick";
    h.CmdLines = {"-c4"};
    h.History = {"2004-01-01 x"};
    h.Comments = {"// read", "typed", "/x", ""};
    h.ColorLines = {"0 COLOR a", "", "0 COLOR b"};
    EXPECT_EQ(ComposeHeader(h), "0 \r\n0 Name: \r\n0 Author: Unknown\r\n0 !LICENSE L\r\n\r\n"
                                "0 !HELP h1\r\n0 !HELP \r\n\r\n"
                                "0 !CATEGORY Brick\r\n\r\n"
                                "0 !CMDLINE -c4\r\n\r\n"
                                "0 !HISTORY 2004-01-01 x\r\n\r\n"
                                "0 // read\r\n0 // typed\r\n0 // /x\r\n0 // \r\n\r\n"
                                "0 COLOR a\r\n0 COLOR b\r\n");
}

TEST(Composer, UpdateTagOnlyForOfficialPartTypes)
{
    HeaderData h;
    h.UpdateTag = "2004-01";
    EXPECT_EQ(ComposeHeader(h).find("LDRAW_ORG"), std::string::npos);
    h.PartType = "Unofficial_Part";
    EXPECT_NE(ComposeHeader(h).find("0 !LDRAW_ORG Unofficial_Part\r\n"), std::string::npos);
    h.PartType = "unofficial_Part";
    EXPECT_NE(ComposeHeader(h).find("0 !LDRAW_ORG unofficial_Part UPDATE 2004-01\r\n"), std::string::npos);
}

} // namespace
