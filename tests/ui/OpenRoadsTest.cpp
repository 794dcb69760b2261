// SPDX-License-Identifier: MIT
// What happens to the open file when another one is opened, dropped or fails to open, and the
// signs of its state: the caption's mark, the status line after a save, the shortcuts.
#include <QAction>
#include <QComboBox>
#include <QDialog>
#include <QLabel>
#include <QLineEdit>
#include <QMenu>
#include <QMimeData>
#include <QPushButton>
#include <QTest>
#include <filesystem>

#include "WindowFixture.h"
#include "frmHelp.h"

namespace {

class ChangedFileTest : public WindowTest {
protected:
    void SetUp() override
    {
        startUp();
        app.Prefs.MakeBackup = false;
        path = part("3001.dat", GoodPart);
        openThroughPendingFile(path);
        auto* description = child<QLineEdit>("txPartDescription");
        description->setFocus();
        QTest::keyClicks(description, "x");
    }
    std::string path;
};

TEST_F(ChangedFileTest, OpenAsksBeforeTheFileDialogAndNoOrCancelWriteNothing)
{
    dialogs.expectMessage(Answer::Cancel);
    window->MDateiOeffnen_Click();
    EXPECT_EQ(dialogs.messages.back().title, "Current File has changed");
    EXPECT_TRUE(dialogs.fileDialogsShown.empty()) << "Cancel: no file dialog";
    dialogs.expectMessage(Answer::No);
    dialogs.expectOpenFile(std::nullopt);
    window->MDateiOeffnen_Click();
    EXPECT_EQ(dialogs.fileDialogsShown.size(), 1u);
    EXPECT_EQ(ReadBytes(path), GoodPart);
    EXPECT_EQ(caption(), "Quillmark 1.0.0 [3001.dat]*") << "the edit is still there";

    dialogs.expectMessage(Answer::Yes); // saves with the checks, then asks for the file
    dialogs.expectOpenFile(std::nullopt);
    window->MDateiOeffnen_Click();
    EXPECT_NE(ReadBytes(path).find("0 xBrick  2 x 4\r\n"), std::string::npos);
    EXPECT_EQ(caption(), "Quillmark 1.0.0 [3001.dat]");
}

TEST_F(ChangedFileTest, ADroppedFileAsksAndNoOpensItWithoutSaving)
{
    const auto other = part("other.dat", "0 Other\r\n");
    QMimeData dropped;
    dropped.setUrls({QUrl::fromLocalFile(QString::fromStdString(other))});
    dialogs.expectMessage(Answer::Cancel);
    Drop(*window, dropped);
    EXPECT_EQ(caption(), "Quillmark 1.0.0 [3001.dat]*");
    dialogs.expectMessage(Answer::No);
    Drop(*window, dropped);
    EXPECT_EQ(dialogs.messages.back().title, "Current File has changed");
    EXPECT_EQ(caption(), "Quillmark 1.0.0 [other.dat]");
    EXPECT_EQ(ReadBytes(path), GoodPart);
}

// A file that cannot be opened leaves the open one as it was: caption, fields, path, recent
// files and the state of its edits.
TEST_F(ChangedFileTest, AFailedOpenKeepsTheOpenFile)
{
    std::filesystem::create_directory(work.path() / "folder.dat");
    const std::pair<std::string, int> failures[] = {
        {work.file("folder.dat"), 1},                                       // the read error
        {part("empty.dat", ""), 1},                                         // "Input past end of file"
        {work.file("missing.dat"), 1},                                      // the read error
        {part("picture.dat", std::string("\x89PNG\r\n\x1a\n\0\0", 10)), 1}, // no text file
    };
    for (const auto& [failing, boxes] : failures) {
        dialogs.expectMessage(Answer::No); // open without saving
        for (int i = 0; i < boxes; ++i)
            dialogs.expectMessage(Answer::Ok);
        openThroughPendingFile(failing);
        EXPECT_EQ(caption(), "Quillmark 1.0.0 [3001.dat]*") << failing;
        EXPECT_EQ(app.Header.FilePath, path);
        EXPECT_EQ(text("txPartDescription"), "xBrick  2 x 4");
        EXPECT_EQ(app.Header.PartDescription, "xBrick  2 x 4");
        EXPECT_EQ(child<QAction>("MRecentFile_1")->text().toStdString(), path);
        EXPECT_FALSE(child<QAction>("MRecentFile_2")->isVisible());
        EXPECT_TRUE(child<QAction>("MDateiSpeichern")->isEnabled());
    }
    EXPECT_EQ(dialogs.messages.back().text, work.file("picture.dat") + " is not an LDraw text file.");
    dialogs.expectMessage(Answer::Yes); // the close question: the edit is still there to save
    EXPECT_TRUE(window->close());
    EXPECT_NE(ReadBytes(path).find("0 xBrick  2 x 4\r\n"), std::string::npos);
}

// Notes saved as ".dat" open only after a question whose No keeps the open file and the recent
// files as they were.
TEST_F(ChangedFileTest, TextWithoutLDrawLinesOpensOnlyWhenTheUserSaysSo)
{
    const std::string prose = "Notes for the brick\r\n0\r\n10 studs on top\n 0 \t\r\n";
    const auto notes = part("notes.dat", prose);
    const auto question = notes + " does not look like an LDraw file. Open it anyway?";
    // An LDraw line past the 64 KiB looked at.
    const auto late = part("late.dat", prose + std::string(70000, ' ') + "\r\n0 Name: late.dat\r\n");
    dialogs.expectMessage(Answer::No); // open without saving
    dialogs.expectMessage(Answer::No);
    openThroughPendingFile(notes);
    EXPECT_EQ(dialogs.messages.back().text, question);
    EXPECT_EQ(dialogs.messages.back().defaultButton, Answer::No);
    EXPECT_EQ(caption(), "Quillmark 1.0.0 [3001.dat]*");
    EXPECT_FALSE(child<QAction>("MRecentFile_2")->isVisible());
    for (const auto& [file, answer] : {std::pair{late, Answer::No}, std::pair{notes, Answer::Yes}}) {
        dialogs.expectMessage(Answer::No);
        dialogs.expectMessage(answer);
        openThroughPendingFile(file);
    }
    EXPECT_EQ(dialogs.messages.back().text, question);
    EXPECT_EQ(caption(), "Quillmark 1.0.0 [notes.dat]");
    openThroughPendingFile(part("geometry.dat", "\r\n \t3 16 0 0 0 1 1 1 0 0 1\r\n"));
    EXPECT_EQ(caption(), "Quillmark 1.0.0 [geometry.dat]") << "a geometry line is LDraw: no question";
}

TEST_F(WindowTest, AFailedFirstOpenLeavesTheWindowAsAtStartUp)
{
    dialogs.expectMessage(Answer::Ok);
    startUp({QString::fromStdString(work.file("missing.dat"))});
    EXPECT_EQ(caption(), "Quillmark 1.0.0");
    EXPECT_FALSE(child<QAction>("MDateiSpeichern")->isEnabled());
    EXPECT_FALSE(child<QWidget>("txPartDescription")->isEnabled());
    EXPECT_FALSE(app.Header.FileLoaded);
    dialogs.expectOpenFile(std::nullopt);
    window->MDateiOeffnen_Click(); // nothing to save, nothing asked
    EXPECT_EQ(dialogs.fileDialogsShown.size(), 1u);
}

TEST_F(ChangedFileTest, SaveClearsTheMarkAndSaysWhereItWrote)
{
    app.Prefs.MakeBackup = true;
    window->MDateiSpeichern_Click();
    EXPECT_EQ(caption(), "Quillmark 1.0.0 [3001.dat]");
    EXPECT_EQ(text("lblStatuszeile"),
              "Saved " + path + " (backup 3001_Backup_2008-08-10_14-05-09.dat); Checks: 1 warning (Ctrl+T)");
    EXPECT_TRUE(window->close()) << "saved: no question";
}

TEST_F(ChangedFileTest, ShortcutsRunTheirCommands)
{
    window->activateWindow();
    ASSERT_TRUE(QTest::qWaitForWindowActive(window.get()));
    QTest::keyClick(window.get(), Qt::Key_S, Qt::ControlModifier);
    EXPECT_EQ(caption(), "Quillmark 1.0.0 [3001.dat]") << "Ctrl+S saved";
    dialogs.expectOpenFile(std::nullopt);
    QTest::keyClick(window.get(), Qt::Key_O, Qt::ControlModifier);
    EXPECT_EQ(dialogs.fileDialogsShown.size(), 1u) << "Ctrl+O";
    bool helpShown = false;
    whenDialogShows<frmHelp>([&helpShown](frmHelp& help) {
        helpShown = true;
        help.accept();
    });
    QTest::keyClick(window.get(), Qt::Key_F1);
    EXPECT_TRUE(helpShown) << "F1";
    dialogs.expectMessage(Answer::Ok);
    child<QAction>("MInfo")->trigger();
    EXPECT_EQ(dialogs.messages.back().text.rfind("Quillmark Version: 1.0.0", 0), 0u) << "Help › About";
    window->activateWindow();
    ASSERT_TRUE(QTest::qWaitForWindowActive(window.get()));
    QTest::keyClick(window.get(), Qt::Key_Q, Qt::ControlModifier);
    EXPECT_FALSE(window->isVisible()) << "Ctrl+Q";
}

// Alt+F opens the File menu as Alt+I does, and no key pressed with Alt types into a field.
TEST_F(ChangedFileTest, AltKeysOpenMenusAndTypeNothing)
{
    window->activateWindow();
    ASSERT_TRUE(QTest::qWaitForWindowActive(window.get()));
    auto* description = child<QLineEdit>("txPartDescription");
    auto* fileMenu = child<QMenu>("MDatei");
    for (const auto key : {Qt::Key_F, Qt::Key_I, Qt::Key_Z}) {
        description->setFocus();
        QTest::keyClick(description, key, Qt::AltModifier);
        EXPECT_EQ(fileMenu->isVisible(), key != Qt::Key_Z) << "Alt+" << QKeySequence(key).toString().toStdString();
        fileMenu->close();
    }
    EXPECT_EQ(text("txPartDescription"), "xBrick  2 x 4");
}

// The user name typed in the preferences is the one the History stub offers at once.
TEST_F(WindowTest, HistoryAddOffersTheUserNameJustSetInThePreferences)
{
    startUp();
    openThroughPendingFile(part("3001.dat", GoodPart));
    whenDialogShows<QDialog>([](QDialog& preferences) {
        preferences.findChild<QLineEdit*>("txRealName")->setText("Jo Tester");
        preferences.findChild<QLineEdit*>("txUserName")->setText("jtester");
        preferences.findChild<QPushButton*>("cmdSave")->click();
    });
    window->MEinstellDefault_Click();
    clock.set({2026, 12, 6, 10, 0, 0});
    dialogs.expectInput("");
    child<QPushButton>("cmdHistoryAdd")->click();
    EXPECT_EQ(dialogs.inputsShown.back().defaultText, "2026-12-06 [jtester] ");
}

} // namespace
