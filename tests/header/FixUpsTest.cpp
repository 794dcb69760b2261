#include <gtest/gtest.h>

#include "DescriptionTabs.h"
#include "FixUps.h"
#include "ScriptedDialogs.h"

namespace {

TEST(DeleteRotationLines, RemovesLinesStartingWithTheExactKeyword)
{
    std::string body = "0 ROTATION CENTER 0 0 0 1 \"Custom\"\r\n\r\n1 16 a.dat\r\n0 ROTATION CONFIG 0 0\r\n"
                       "0 rotation x\r\n  0 ROTATION y\r\n\r\n2 24 b";
    DeleteRotationLines(body);
    EXPECT_EQ(body, "1 16 a.dat\r\n0 rotation x\r\n  0 ROTATION y\r\n\r\n2 24 b");
    std::string empty;
    DeleteRotationLines(empty);
    EXPECT_EQ(empty, "");
    std::string trailing = "1 a\r\n";
    DeleteRotationLines(trailing);
    EXPECT_EQ(trailing, "1 a\r\n");
}

TEST(FixUpTests, LookInAnyCase)
{
    EXPECT_TRUE(HasCertifyInvertNext("x\r\n0 bfc certify invertnext"));
    EXPECT_TRUE(HasRotationLines("0 // see 0 Rotation 1"));
    EXPECT_FALSE(HasRotationLines("0 ROTATION"));
    EXPECT_TRUE(HasWriteLines("0 write x"));
    EXPECT_FALSE(HasWriteLines("0 WRITE"));
}

TEST(FixUpCorrections, ReplaceEveryExactOccurrence)
{
    std::string body = "0 BFC CERTIFY INVERTNEXT\r\n1 a\r\n0 BFC CERTIFY INVERTNEXT";
    FixCertifyInvertNext(body);
    EXPECT_EQ(body, "0 BFC INVERTNEXT\r\n1 a\r\n0 BFC INVERTNEXT");
    body = "0 WRITE Hello\r\n0 // 10 WRITE";
    RemoveWriteKeywords(body);
    EXPECT_EQ(body, "0 Hello\r\n0 // 10");
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
}

} // namespace
