// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "Composer.h"
#include "FixedClock.h"
#include "SaveChecks.h"
#include "ScriptedDialogs.h"
#include "TempDir.h"

namespace {

const std::string NotPossible = "\r\nSaving the file is not possible";

class SaveChecks : public ::testing::Test {
protected:
    SaveChecks()
    {
        h.FilePath = dir.write("3001.dat", "old\r\n");
        h.PartDescription = "Brick 2 x 4";
        h.AuthorRealName = "Jane Doe";
        h.AuthorUserName = "jdoe";
        h.Bfc = "CERTIFY CCW";
        h.License = "Licensed under CC BY 4.0 : see CAreadme.txt";
        h.PartType = "Part";
        h.Body = "1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat";
        h.FileChanged = true;
    }

    SaveResult save()
    {
        return CheckHeaderAndSave(h, {dialogs, clock, false, [this] { return ComposeHeader(h); },
                                      [this] { ++recomposed; }, limitDescription});
    }
    std::string saved() const { return ReadBytes(h.FilePath); }
    TempDir dir;
    HeaderData h;
    ScriptedDialogs dialogs;
    FixedClock clock;
    int recomposed = 0;
    bool limitDescription = true;
};

TEST_F(SaveChecks, DescriptionOfSixtyFiveCharactersIsRefusedUnlessTheLimitIsOff)
{
    h.PartDescription = std::string(64, 'x');
    EXPECT_EQ(save().outcome, SaveOutcome::Saved);
    h.PartDescription = std::string(65, 'x');
    dialogs.expectMessage(Answer::Ok);
    EXPECT_EQ(save().outcome, SaveOutcome::DescriptionTooLong);
    // With the limit lifted, only the length rule goes.
    h.PartDescription = std::string(300, 'x');
    limitDescription = false;
    EXPECT_EQ(save().outcome, SaveOutcome::Saved);
    h.Bfc.clear();
    EXPECT_EQ(EvaluateSaveChecks(h, false).refusals,
              std::vector<std::string>{RefusalText("You need to set the BFC type!")});
}

TEST_F(SaveChecks, DescriptionLengthCountsCharactersOfAUtf8File)
{
    h.Encoding = TextEncoding::Utf8;
    std::string umlauts;
    for (int i = 0; i < 64; ++i)
        umlauts += "\xc3\xb6";
    h.PartDescription = umlauts;
    EXPECT_EQ(save().outcome, SaveOutcome::Saved);
    h.Encoding = TextEncoding::Latin1;
    h.PartDescription = std::string(65, '\xf6');
    dialogs.expectMessage(Answer::Ok);
    EXPECT_EQ(save().outcome, SaveOutcome::DescriptionTooLong);
}

// A save stops at the first failing check, and a check lists them all in the same order.
TEST_F(SaveChecks, ChecksStopAtTheFirstFailureInTheirOneOrder)
{
    h.PartDescription = std::string(65, 'x');
    h.NeedsWork = true;
    h.AuthorRealName.clear();
    h.AuthorUserName.clear();
    h.Bfc.clear();
    h.License.clear();
    h.PartType.clear();
    const std::vector<std::string> order = {"Length of the part description is limited to 64 characters!",
                                            "You need to mention the Author!",
                                            "You need to set the BFC type!",
                                            "You need to set the License type!",
                                            "You need to set the Part type!",
                                            "Parts with 'needs work' in title needs a proper comment!"};
    std::vector<std::string> listed;
    for (const auto& sentence : order)
        listed.push_back(sentence + NotPossible);
    EXPECT_EQ(EvaluateSaveChecks(h).refusals, listed);
    EXPECT_TRUE(EvaluateSaveChecks(h).missingUserName);
    h.Comments = {"// rough"}; // what a part that needs work must have
    EXPECT_EQ(EvaluateSaveChecks(h).refusals, std::vector(listed.begin(), listed.end() - 1));

    // A save names the first failure alone and writes nothing.
    dialogs.expectMessage(Answer::Ok);
    EXPECT_EQ(save().outcome, SaveOutcome::DescriptionTooLong);
    h.PartDescription = "Brick";
    dialogs.expectMessage(Answer::Ok);
    EXPECT_EQ(save().outcome, SaveOutcome::Refused);
    ASSERT_EQ(dialogs.messages.size(), 2u);
    EXPECT_EQ(dialogs.messages[0].text, listed[0]);
    EXPECT_EQ(dialogs.messages[1].text, listed[1]);
    EXPECT_EQ(dialogs.messages[1].icon, Icon::None);
    EXPECT_EQ(saved(), "old\r\n");
}

TEST_F(SaveChecks, MissingUserNameQuestion)
{
    h.AuthorUserName.clear();
    dialogs.expectMessage(Answer::No);
    EXPECT_EQ(save().outcome, SaveOutcome::Declined);
    EXPECT_EQ(saved(), "old\r\n");
    ASSERT_EQ(dialogs.messages.size(), 1u);
    const auto& box = dialogs.messages[0];
    EXPECT_EQ(box.title, "Missing Username");
    EXPECT_EQ(box.defaultButton, Answer::Yes);

    h.Bfc.clear();
    dialogs.expectMessage(Answer::Yes);
    dialogs.expectMessage(Answer::Ok);
    EXPECT_EQ(save().outcome, SaveOutcome::Refused);
    EXPECT_EQ(dialogs.messages.back().text, "You need to set the BFC type!" + NotPossible);
}

TEST_F(SaveChecks, FixUpQuestionsInOrderAndYesCorrectsExactCaseOnlyNoNothing)
{
    h.Body = "0 BFC CERTIFY INVERTNEXT\r\n0 bfc certify invertnext\r\n0 ROTATION CENTER 0 0 0\r\n"
             "0 // see 0 ROTATION 1 0 0 90\r\n0 WRITE Hello\r\n1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat";
    h.ColorLines = {"0 COLOR 4 red"};
    for (const auto answer : {Answer::Yes, Answer::Yes, Answer::No, Answer::Yes})
        dialogs.expectMessage(answer);
    EXPECT_EQ(save().outcome, SaveOutcome::Saved);
    ASSERT_EQ(dialogs.messages.size(), 4u);
    EXPECT_EQ(dialogs.messages[0].title, "BFC CERTIFY INVERTNEXT");
    EXPECT_EQ(dialogs.messages[0].text, "Should this be corrected?");
    EXPECT_EQ(dialogs.messages[1].title, "ROTATION in file");
    EXPECT_EQ(dialogs.messages[1].text, "Should the \"0 ROTATION\" entries being deleted?");
    EXPECT_EQ(dialogs.messages[2].title, "ROTATION in file");
    EXPECT_EQ(dialogs.messages[2].text, "Should the \"0 WRITE\" entries being deleted?");
    EXPECT_EQ(dialogs.messages[3].title, "COLOR Entry");
    EXPECT_EQ(dialogs.messages[3].text, "Should the COLOR Entry be deleted?");
    EXPECT_EQ(h.Body, "0 BFC INVERTNEXT\r\n0 bfc certify invertnext\r\n0 // see 0 ROTATION 1 0 0 90\r\n"
                      "0 WRITE Hello\r\n1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat");
    EXPECT_TRUE(h.ColorLines.empty());
    EXPECT_EQ(recomposed, 1);
    EXPECT_EQ(saved().find("COLOR"), std::string::npos);
}

} // namespace
