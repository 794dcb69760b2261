// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "DescriptionTabs.h"
#include "FixUps.h"
#include "ScriptedDialogs.h"

namespace {

TEST(DeleteRotationLines, RemovesLinesStartingWithTheKeywordInAnyCase)
{
    std::string body = "0 ROTATION CENTER 0 0 0 1 \"Custom\"\r\n\r\n1 16 a.dat\r\n0 ROTATION CONFIG 0 0\r\n"
                       "0 rotation x\r\n0 // see 0 ROTATION y\r\n0 ROTATIONS\r\n\r\n2 24 b";
    DeleteRotationLines(body);
    EXPECT_EQ(body, "1 16 a.dat\r\n0 // see 0 ROTATION y\r\n0 ROTATIONS\r\n\r\n2 24 b");
    body = "1 a\r\n";
    DeleteRotationLines(body);
    EXPECT_EQ(body, "1 a\r\n");
}

// A question is asked exactly when its answer Yes would change the body.
TEST(FixUpTests, FindWhatTheCorrectionChanges)
{
    EXPECT_TRUE(HasCertifyInvertNext("x\r\n0 bfc certify invertnext"));
    EXPECT_TRUE(HasRotationLines("1 a\r\n0 Rotation center"));
    EXPECT_FALSE(HasRotationLines("0 // see 0 ROTATION 1\r\n0 ROTATION"));
    EXPECT_TRUE(HasWriteLines("1 a\r\n0 write x"));
    EXPECT_TRUE(HasWriteLines("0 WRITE"));
    EXPECT_FALSE(HasWriteLines("0 // 10 WRITE x\r\n0 WRITES are fun\r\n1 0 WRITE"));
}

TEST(FixUpCorrections, ChangeOnlyTheLinesTheyAreAbout)
{
    std::string body = "0 BFC CERTIFY INVERTNEXT\r\n1 a\r\n0 BFC CERTIFY INVERTNEXT";
    FixCertifyInvertNext(body);
    EXPECT_EQ(body, "0 BFC INVERTNEXT\r\n1 a\r\n0 BFC INVERTNEXT");
    body = "0 WRITE Hello\r\n0 // 10 WRITES are fun\r\n0 write x\r\n0 WRITES\r\n0 WRITE";
    RemoveWriteKeywords(body);
    EXPECT_EQ(body, "0 Hello\r\n0 // 10 WRITES are fun\r\n0 x\r\n0 WRITES\r\n0");
}

TEST(RemoveDescriptionTabs, RemovesTabsAfterTellingTheUser)
{
    HeaderData h;
    h.PartDescription = "Brick\t2 x 4\t";
    ScriptedDialogs dialogs;
    dialogs.expectMessage(Answer::Ok);
    EXPECT_TRUE(RemoveDescriptionTabs(h, dialogs));
    EXPECT_EQ(h.PartDescription, "Brick2 x 4");
    ASSERT_EQ(dialogs.messages.size(), 1u);
    EXPECT_EQ(dialogs.messages[0].text, "A TAB character was found in the Part Description and will be deleted");
    EXPECT_FALSE(RemoveDescriptionTabs(h, dialogs));
    h.PartDescription = "Brick \t";
    dialogs.expectMessage(Answer::Ok);
    RemoveDescriptionTabs(h, dialogs);
    EXPECT_EQ(h.PartDescription, "Brick") << "no blank left at the end of the line";
}

} // namespace
