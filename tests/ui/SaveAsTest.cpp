// SPDX-License-Identifier: MIT
// Read-only parts, Save As, and another program's changes to the open part.
#include <QAction>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QTest>
#include <filesystem>
#include <fstream>
#include <sys/stat.h>

#include "RecentFiles.h"
#include "SettingsStore.h"
#include "WindowFixture.h"

namespace {

std::size_t backupsIn(const std::filesystem::path& folder)
{
    std::size_t backups = 0;
    for (const auto& entry : std::filesystem::directory_iterator(folder))
        backups += entry.path().filename().string().find("_Backup_") != std::string::npos ? 1 : 0;
    return backups;
}

void typeInto(QWidget* box, const char* typed)
{
    box->setFocus();
    QTest::keyClick(box, Qt::Key_End);
    QTest::keyClicks(box, typed);
}

// A part this user may not write (no write permission at all, which even root keeps to) says so in its caption and
// status line; Save names the file and the reason and offers Save As, which writes a new file (no backup, the Name:
// line offered the new name) and goes on with it.
TEST_F(WindowTest, AReadOnlyPartIsSaidAtOpenAndSavedUnderANewName)
{
    startUp();
    const auto path = part("3001.dat", GoodPart);
    ::chmod(path.c_str(), 0444);
    openThroughPendingFile(path);
    EXPECT_TRUE(caption().ends_with("[3001.dat] [read-only]")) << caption();
    EXPECT_EQ(text("lblStatuszeile"), "Read-only (permission denied): Save As (Ctrl+Shift+S) keeps your changes.");
    typeInto(child<QWidget>("txPartDescription"), " Plain");

    const auto copy = work.file("3001b.dat");
    dialogs.expectMessage(Answer::Yes); // save it elsewhere
    dialogs.expectOpenFile(copy);       // the new name
    dialogs.expectMessage(Answer::Yes); // the Name: line takes it
    window->MDateiSpeichern_Click();
    EXPECT_EQ(dialogs.messages[0].text.find("Cannot save " + path + ": permission denied."), 0u);
    EXPECT_TRUE(dialogs.fileDialogsShown.back().forSaving);
    EXPECT_NE(dialogs.messages[1].text.find("3001b.dat"), std::string::npos);
    EXPECT_EQ(ReadBytes(path), GoodPart) << "the part read stays as it was";
    const auto written = ReadBytes(copy);
    EXPECT_EQ(written.find("0 Brick  2 x 4 Plain\r\n0 Name: 3001b.dat\r\n"), 0u) << written;
    EXPECT_EQ(backupsIn(work.path()), 0u) << "no backup of a file that did not exist";
    EXPECT_EQ(app.Header.FilePath, copy);
    EXPECT_TRUE(caption().ends_with("[3001b.dat]")) << caption();
    EXPECT_FALSE(app.Header.FileChanged);
    EXPECT_EQ(store.read(RecentFilesGroup, "RecentFile1", ""), copy);
    EXPECT_NE(child<QPlainTextEdit>("txOldHeader")->toPlainText().indexOf("0 Name: 3001b.dat"), -1)
        << "the old header is the one on disk now";
}

// Save As never writes over an existing file without asking: No leaves it, and the document as it
// was; Yes replaces it.
TEST_F(WindowTest, SaveAsAsksBeforeReplacingAnExistingFile)
{
    startUp();
    const auto path = part("3001.dat", GoodPart);
    const auto other = part("other.dat", "0 another part\r\n");
    openThroughPendingFile(path);
    app.Prefs.MakeBackup = false;
    dialogs.expectOpenFile(other);
    dialogs.expectMessage(Answer::No); // not over other.dat
    child<QAction>("MDateiSpeichernUnter")->trigger();
    EXPECT_NE(dialogs.messages.back().text.find(other + " already exists."), std::string::npos);
    EXPECT_EQ(ReadBytes(other), "0 another part\r\n");
    EXPECT_EQ(app.Header.FilePath, path);

    dialogs.expectOpenFile(other);
    dialogs.expectMessage(Answer::Yes); // over other.dat
    dialogs.expectMessage(Answer::No);  // the Name: line stays 3001.dat
    QTest::keyClick(window.get(), Qt::Key_S, Qt::ControlModifier | Qt::ShiftModifier);
    EXPECT_EQ(ReadBytes(other).find("0 Brick  2 x 4\r\n0 Name: 3001.dat\r\n"), 0u);
    EXPECT_EQ(ReadBytes(path), GoodPart);
    EXPECT_EQ(app.Header.FilePath, other);
}

// Another program's change to the open part is noticed without any command: the question offers
// Reload as its default while the document has no change, and the reload keeps nothing of it.
TEST_F(WindowTest, AChangeOnDiskIsNoticedAndReloadKeepsNothingOfTheOldDocument)
{
    startUp();
    const auto path = part("3001.dat", GoodPart);
    openThroughPendingFile(path);
    auto changed = GoodPart;
    changed.replace(changed.find("Brick  2 x 4"), 12, "Brick  2 x 6");
    dialogs.expectMessage(Answer::Yes);
    std::ofstream(path, std::ios::binary | std::ios::trunc) << changed;
    ASSERT_TRUE(QTest::qWaitFor([&] { return !dialogs.messages.empty(); }, 5000)) << "the watcher fired";
    EXPECT_EQ(dialogs.messages[0].text.find(path + " was changed by another program."), 0u);
    EXPECT_EQ(dialogs.messages[0].defaultButton, Answer::Yes);
    EXPECT_EQ(text("txPartDescription"), "Brick  2 x 6");
    EXPECT_NE(child<QPlainTextEdit>("txOldHeader")->toPlainText().indexOf("Brick  2 x 6"), -1);

    typeInto(child<QWidget>("txAuthorRealName"), "son");
    dialogs.expectMessage(Answer::Yes);
    std::ofstream(path, std::ios::binary | std::ios::trunc) << GoodPart;
    ASSERT_TRUE(QTest::qWaitFor([&] { return dialogs.messages.size() == 2; }, 5000));
    EXPECT_EQ(dialogs.messages[1].defaultButton, Answer::No) << "the document has a change of its own";
    EXPECT_EQ(text("txAuthorRealName"), "Sam Sample");
    EXPECT_EQ(app.Header.AuthorRealName, "Sam Sample");
    EXPECT_FALSE(app.Header.FileChanged);
    EXPECT_EQ(text("txPartDescription"), "Brick  2 x 4");
}

} // namespace
