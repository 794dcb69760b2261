// SPDX-License-Identifier: MIT
// The questions before closing, opening and editing lists, each answer and what follows.
#include <gtest/gtest.h>

#include "DocumentQuestions.h"
#include "FixedClock.h"
#include "IniSettingsStore.h"
#include "LineLists.h"
#include "ScriptedDialogs.h"
#include "TempDir.h"

namespace {

class DocumentQuestions : public ::testing::Test {
protected:
    DocumentQuestions()
    {
        app.Header.FilePath = dir.write("3001.dat", "0 old\r\n");
        app.Header.FileChanged = true;
        app.Prefs.MakeBackup = false;
    }
    TempDir dir;
    IniSettingsStore store{dir.file("Quillmark.ini")};
    ScriptedDialogs dialogs;
    FixedClock clock;
    Services services{store, dialogs, clock};
    AppState app;
};

TEST_F(DocumentQuestions, CloseAsksWhenChangedAndYesSavesWithoutTheChecks)
{
    dialogs.expectMessage(Answer::Cancel);
    EXPECT_FALSE(MayCloseWindow(app, services, "0 new\r\n"));
    EXPECT_EQ(dialogs.messages.back().title, "File Changed");
    EXPECT_EQ(dialogs.messages.back().defaultButton, Answer::Yes);
    dialogs.expectMessage(Answer::No);
    EXPECT_TRUE(MayCloseWindow(app, services, "0 new\r\n"));
    EXPECT_EQ(ReadBytes(app.Header.FilePath), "0 old\r\n");
    dialogs.expectMessage(Answer::Yes); // the record has no author: saved all the same
    EXPECT_TRUE(MayCloseWindow(app, services, "0 new\r\n"));
    EXPECT_EQ(ReadBytes(app.Header.FilePath), "0 new\r\n\r\n");
    EXPECT_TRUE(MayCloseWindow(app, services, "0 new\r\n")) << "saved: no question";
    app.Header.FileChanged = true;
    ::chmod(app.Header.FilePath.c_str(), 0444);
    dialogs.expectMessage(Answer::Yes);
    dialogs.expectMessage(Answer::Ok); // the failed save's report
    EXPECT_FALSE(MayCloseWindow(app, services, "0 newer\r\n"));
}

TEST_F(DocumentQuestions, OpeningAnotherFileAsksFirst)
{
    int saves = 0;
    const auto save = [&saves](bool outcome) {
        return [&saves, outcome] {
            ++saves;
            return outcome;
        };
    };
    dialogs.expectMessage(Answer::Cancel);
    EXPECT_FALSE(MayOpenAnotherFile(app, dialogs, save(true)));
    EXPECT_EQ(dialogs.messages.back().defaultButton, Answer::Yes);
    dialogs.expectMessage(Answer::No);
    EXPECT_TRUE(MayOpenAnotherFile(app, dialogs, save(true)));
    dialogs.expectMessage(Answer::Yes);
    EXPECT_FALSE(MayOpenAnotherFile(app, dialogs, save(false))) << "a refused save keeps the file open";
    dialogs.expectMessage(Answer::Yes);
    EXPECT_TRUE(MayOpenAnotherFile(app, dialogs, save(true)));
    EXPECT_EQ(saves, 2);
    app.Header.FileChanged = false;
    EXPECT_TRUE(MayOpenAnotherFile(app, dialogs, save(false)));
    EXPECT_EQ(saves, 2);
}

TEST_F(DocumentQuestions, OnlyTheCategoryListWarnsBeforeItsEditor)
{
    EXPECT_TRUE(MayEditList(ListKind::Bfc, dialogs));
    dialogs.expectMessage(Answer::No);
    EXPECT_FALSE(MayEditList(ListKind::Category, dialogs));
    EXPECT_EQ(dialogs.messages.back().title, "Category Change");
    EXPECT_EQ(dialogs.messages.back().defaultButton, Answer::No);
    dialogs.expectMessage(Answer::Yes);
    EXPECT_TRUE(MayEditList(ListKind::Category, dialogs));
}

TEST_F(DocumentQuestions, SetPreferencesTakesTheStoredValuesOnYes)
{
    store.write(DefaultGroup, "RealName", "Jane Doe");
    store.write(DefaultGroup, "Liscense", "Unknown licence");
    app.Header.AuthorRealName = "Sam";
    app.Header.AuthorUserName = "sam";
    app.Header.License = "L";
    app.Lists.Licenses = {"L"};
    const auto asIs = [](const std::string& utf8) { return std::optional(utf8); };
    dialogs.expectMessage(Answer::No);
    EXPECT_FALSE(TakePreferencesIntoRecord(app, services, asIs));
    EXPECT_EQ(dialogs.messages.back().title, "Default Values");
    EXPECT_EQ(app.Header.AuthorRealName, "Sam");
    dialogs.expectMessage(Answer::Yes);
    EXPECT_TRUE(TakePreferencesIntoRecord(app, services, asIs));
    EXPECT_EQ(app.Header.AuthorRealName, "Jane Doe");
    EXPECT_EQ(app.Header.AuthorUserName, "sam") << "a user name the preferences lack leaves the record's";
    EXPECT_EQ(app.Header.License, "L") << "a licence that no entry matches leaves the record's";
}

// A history line out of the form the Parts Tracker takes is pointed out before it is taken: No
// gives the box back with the text to mend, Yes keeps it; the other lists take any line.
TEST(LineQuestions, HistoryLinesTheTrackerWouldRefuseAreAskedAbout)
{
    ScriptedDialogs dialogs;
    dialogs.expectInput("2008-03-05 [] Changed licence to CC BY 4.0");
    dialogs.expectMessage(Answer::No);
    dialogs.expectInput("2008-03-05 {Jane Doe} Changed licence to CC BY 4.0");
    EXPECT_EQ(AskForLine(dialogs, HistoryPrompt, "History", "2008-03-05 [] ", true),
              "2008-03-05 {Jane Doe} Changed licence to CC BY 4.0");
    ASSERT_EQ(dialogs.inputsShown.size(), 2u);
    EXPECT_EQ(dialogs.inputsShown[0].defaultText, "2008-03-05 [] ");
    EXPECT_EQ(dialogs.inputsShown[1].defaultText, "2008-03-05 [] Changed licence to CC BY 4.0");
    ASSERT_EQ(dialogs.messages.size(), 1u);
    EXPECT_EQ(dialogs.messages[0].defaultButton, Answer::No);

    dialogs.expectInput("Changed licence to CC BY 4.0");
    dialogs.expectMessage(Answer::Yes);
    EXPECT_EQ(AskForLine(dialogs, HistoryPrompt, "History", "", true), "Changed licence to CC BY 4.0");
    dialogs.expectInput("   ");
    EXPECT_EQ(AskForLine(dialogs, HistoryPrompt, "History", "", true), "   ") << "nothing typed, nothing asked";
    dialogs.expectInput("Changed licence");
    EXPECT_EQ(AskForLine(dialogs, "Please enter your Comment", "Comment", "", false), "Changed licence");
    EXPECT_EQ(dialogs.messages.size(), 2u);
}

} // namespace
