// SPDX-License-Identifier: MIT
#include <QAction>
#include <QComboBox>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QTest>
#include <QTimer>

#include "WindowFixture.h"

namespace {

// Types characters that QTest's ASCII key table does not know.
void typeText(QWidget* widget, const QString& text)
{
    for (const QChar c : text) {
        QKeyEvent press(QEvent::KeyPress, Qt::Key_unknown, Qt::NoModifier, QString(c));
        QKeyEvent release(QEvent::KeyRelease, Qt::Key_unknown, Qt::NoModifier, QString(c));
        QApplication::sendEvent(widget, &press);
        QApplication::sendEvent(widget, &release);
    }
}

TEST_F(WindowTest, StartsWithDisabledControlsAndEmptyLists)
{
    startUp();
    for (const char* name : {"txPartDescription", "txFileName", "txAuthorRealName", "cbPartTypes", "cmdAdd",
                             "cmdHistoryEdit", "cmdCommentsDelete", "cmdSetPreferences", "txNewHeader"})
        EXPECT_FALSE(child<QWidget>(name)->isEnabled()) << name;
    EXPECT_TRUE(child<QWidget>("lsKeyWords")->isEnabled());
    EXPECT_FALSE(child<QAction>("MDateiSpeichern")->isEnabled());
    EXPECT_FALSE(child<QAction>("MRecentFile_0")->isVisible());
    EXPECT_EQ(child<QComboBox>("cbBFCStatement")->currentIndex(), -1);
}

TEST_F(WindowTest, OpensTheFileNamedOnTheCommandLine)
{
    const auto path = part("copy of 3001.dat", GoodPart);
    startUp({QString::fromStdString(path)});
    EXPECT_EQ(caption(), "Quillmark 1.0.0 [copy of 3001.dat]") << "the name on disk, not the Name: line's";
    EXPECT_EQ(window->focusWidget(), child<QWidget>("txPartDescription")) << "typing goes into the first field";
    EXPECT_EQ(QApplication::overrideCursor(), nullptr) << "the busy pointer is gone";
    EXPECT_EQ(text("txPartDescription"), "Brick  2 x 4");
    EXPECT_EQ(child<QLineEdit>("txPartDescription")->cursorPosition(), 0) << "a long text shows its start";
    EXPECT_EQ(child<QComboBox>("cbCategory")->currentText(), "Brick");
    EXPECT_EQ(child<QListWidget>("lsKeyWords")->item(0)->text(), "brick, stud");
    EXPECT_NE(child<QPlainTextEdit>("txOldHeader")->toPlainText().indexOf("0 !KEYWORDS brick, stud"), -1);
    EXPECT_FALSE(app.Header.FileChanged);
    EXPECT_EQ(store.read(DefaultGroup, "LastPath", ""), work.path().string());
    EXPECT_EQ(child<QAction>("MRecentFile_1")->text().toStdString(), path);
}

// The recent files' road leaves "LastPath" alone; the Open dialog's stores the folder, and its
// Cancel keeps the open file.
TEST_F(WindowTest, OpenDialogRoadStoresTheFolderAndCancelKeepsTheFile)
{
    startUp();
    std::filesystem::create_directory(work.path() / "recent");
    window->OpenFile(work.write("recent/3001.dat", GoodPart));
    EXPECT_FALSE(store.read(DefaultGroup, "LastPath").has_value());
    dialogs.expectOpenFile(part("other.dat", "0 Other part\r\n"));
    window->MDateiOeffnen_Click();
    EXPECT_EQ(store.read(DefaultGroup, "LastPath", ""), work.path().string());
    dialogs.expectOpenFile(std::nullopt);
    window->MDateiOeffnen_Click();
    EXPECT_EQ(dialogs.fileDialogsShown.back().startFolder, work.path().string());
    EXPECT_EQ(caption(), "Quillmark 1.0.0 [other.dat]");
    EXPECT_EQ(app.Header.PartDescription, "Other part");
}

TEST_F(WindowTest, ValuesMissingFromTheListsStayUnselectedButTheHeaderIsComposed)
{
    startUp();
    openThroughPendingFile(part("odd.dat", "0 Odd\r\n0 Author: A [a]\r\n0 !LDRAW_ORG Strange\r\n0 !LICENSE Mine\r\n"
                                           "0 BFC CW\r\n0 !CATEGORY Nothing\r\n"));
    for (const char* combo : {"cbPartTypes", "cbLicenses", "cbBFCStatement", "cbCategory"})
        EXPECT_EQ(child<QComboBox>(combo)->currentIndex(), -1) << combo;
    EXPECT_NE(window->newHeaderText().find("0 !LDRAW_ORG Strange\r\n0 !LICENSE Mine\r\n"), std::string::npos);
    EXPECT_NE(child<QPlainTextEdit>("txNewHeader")->toPlainText().indexOf("0 !LICENSE Mine"), -1);
    EXPECT_FALSE(app.Header.FileChanged);
}

TEST_F(WindowTest, TypingRecomposesAndMarksTheFileChanged)
{
    startUp();
    openThroughPendingFile(part("3001.dat", GoodPart));
    auto* description = child<QLineEdit>("txPartDescription");
    description->setFocus();
    description->setCursorPosition(description->text().size());
    QTest::keyClicks(description, " Extra");
    EXPECT_EQ(app.Header.PartDescription, "Brick  2 x 4 Extra");
    EXPECT_TRUE(app.Header.FileChanged);
    EXPECT_EQ(window->newHeaderText().rfind("0 Brick  2 x 4 Extra\r\n", 0), 0u);
    EXPECT_EQ(text("lblLength"), "Length: 18");
    QTest::keyClicks(description, std::string(50, 'x').c_str());
    EXPECT_EQ(text("lblLength"), "Length: 68");
    EXPECT_NE(child<QLabel>("lblLength")->styleSheet().indexOf("255, 0, 0"), -1);
    app.Prefs.LimitDescription = false; // any length is fine: green
    QTest::keyClicks(description, "y");
    EXPECT_NE(child<QLabel>("lblLength")->styleSheet().indexOf("0, 255, 0"), -1);
}

// Keys that reach a box without being typed there, as Qt delivers them, are no edits: closing the
// window afterwards asks nothing.
TEST_F(WindowTest, KeysMeantForMenusDialogsAndOtherWindowsAreNoEdits)
{
    startUp();
    openThroughPendingFile(part("3001.dat", GoodPart));
    auto* description = child<QLineEdit>("txPartDescription");
    description->setFocus();
    const auto send = [description](QEvent::Type type, int key, Qt::KeyboardModifiers modifiers = {}) {
        QKeyEvent event(type, key, modifiers);
        QApplication::sendEvent(description, &event);
    };
    const auto focus = [description](QEvent::Type type, Qt::FocusReason reason) {
        QFocusEvent event(type, reason);
        QApplication::sendEvent(description, &event);
    };
    // Alt+I opens the File menu, Escape closes it: the box sees Alt pressed, loses the focus to
    // the menu bar and its menu, and then gets the releases.
    send(QEvent::KeyPress, Qt::Key_Alt, Qt::AltModifier);
    focus(QEvent::FocusOut, Qt::PopupFocusReason);
    focus(QEvent::FocusOut, Qt::MenuBarFocusReason);
    focus(QEvent::FocusIn, Qt::MenuBarFocusReason);
    send(QEvent::KeyRelease, Qt::Key_Escape);
    send(QEvent::KeyRelease, Qt::Key_Alt);
    // The about box closed with Enter: the release of Enter lands in the box.
    dialogs.expectMessage(Answer::Ok);
    window->MInfo_Click();
    send(QEvent::KeyRelease, Qt::Key_Return);
    // Another application's window takes the focus and gives it back.
    focus(QEvent::FocusOut, Qt::ActiveWindowFocusReason);
    focus(QEvent::FocusIn, Qt::ActiveWindowFocusReason);
    EXPECT_FALSE(app.Header.FileChanged);
    EXPECT_TRUE(window->close());
}

// Only a header that a save would write differently marks the file: keys that change no text, a
// letter typed and deleted again, and passing through the boxes leave it unchanged.
TEST_F(WindowTest, OnlyAChangedHeaderMarksTheFile)
{
    startUp();
    openThroughPendingFile(part("3001.dat", GoodPart));
    auto* description = child<QLineEdit>("txPartDescription");
    description->setFocus();
    QTest::keyClick(description, Qt::Key_End);
    QTest::keyClick(description, Qt::Key_Left);
    EXPECT_FALSE(app.Header.FileChanged);
    QTest::keyClicks(description, "x");
    EXPECT_TRUE(app.Header.FileChanged);
    EXPECT_EQ(caption(), "Quillmark 1.0.0 [3001.dat]*");
    QTest::keyClick(description, Qt::Key_Backspace);
    child<QLineEdit>("txAuthorRealName")->setFocus(Qt::MouseFocusReason);
    EXPECT_FALSE(app.Header.FileChanged);
    EXPECT_EQ(caption(), "Quillmark 1.0.0 [3001.dat]");
    EXPECT_TRUE(window->close()) << "closes without a question";
}

TEST_F(WindowTest, EnterMovesTheFocusAlongTheFields)
{
    startUp();
    openThroughPendingFile(part("3001.dat", GoodPart));
    window->activateWindow();
    const std::pair<const char*, const char*> chain[] = {{"txPartDescription", "txAuthorRealName"},
                                                         {"txAuthorRealName", "txAuthorUserName"},
                                                         {"txAuthorUserName", "cbPartTypes"},
                                                         {"cbCategory", "lsKeyWords"}};
    for (const auto& [from, to] : chain) {
        auto* control = child<QWidget>(from);
        control->setFocus();
        window->setAttribute(Qt::WA_KeyboardFocusChange, false);
        QTest::keyClick(control, Qt::Key_Return);
        EXPECT_EQ(QApplication::focusWidget(), child<QWidget>(to)) << from;
        // The style draws the focus frame only after a keyboard focus change, as Tab makes.
        EXPECT_TRUE(window->testAttribute(Qt::WA_KeyboardFocusChange)) << from;
    }
}

class LineListTest : public WindowTest {
protected:
    void SetUp() override
    {
        startUp();
        openThroughPendingFile(part("h.dat", "0 H\r\n0 !HISTORY X\r\n0 !HISTORY Y\r\n0 !HISTORY X\r\n"));
        history = child<QListWidget>("lsHistory");
    }
    QListWidget* history = nullptr;
};

TEST_F(LineListTest, EditAndDeleteActOnTheSelectedRowOnly)
{
    history->setCurrentRow(-1);
    child<QPushButton>("cmdHistoryEdit")->click();
    child<QPushButton>("cmdHistoryDelete")->click();
    EXPECT_FALSE(app.Header.FileChanged) << "nothing selected, nothing happens";
    history->setCurrentRow(2);
    dialogs.expectInput("  Z ");
    dialogs.expectMessage(Answer::Yes); // kept, though the Parts Tracker would refuse it
    child<QPushButton>("cmdHistoryEdit")->click();
    EXPECT_EQ(dialogs.inputsShown[0].defaultText, "X");
    EXPECT_EQ(app.Header.History, (EntryList{"X", "Y", "Z"}));
    EXPECT_EQ(RowsOf(*history), (QStringList{"X", "Y", "Z"}));
    history->setCurrentRow(0);
    child<QPushButton>("cmdHistoryDelete")->click();
    EXPECT_EQ(RowsOf(*history), (QStringList{"Y", "Z"}));
    EXPECT_NE(window->newHeaderText().find("0 !HISTORY Y\r\n0 !HISTORY Z\r\n\r\n"), std::string::npos);
}

TEST_F(LineListTest, AddTakesOneEntryAndHistoryOffersTodaysStub)
{
    app.Prefs.DefaultUserName = "jdoe";
    clock.set({2008, 3, 5, 10, 0, 0});
    dialogs.expectInput("2008-03-05 [jdoe] Changed licence");
    child<QPushButton>("cmdHistoryAdd")->click();
    EXPECT_EQ(dialogs.inputsShown[0].defaultText, "2008-03-05 [jdoe] ");
    EXPECT_EQ(app.Header.History[app.Header.History.size() - 1], "2008-03-05 [jdoe] Changed licence");
    dialogs.expectInput("a, b, c");
    child<QPushButton>("cmdAdd")->click();
    dialogs.expectInput("   ");
    child<QPushButton>("cmdCommentsAdd")->click();
    EXPECT_EQ(app.Header.Keywords, (EntryList{"a, b, c"}));
    EXPECT_TRUE(app.Header.Comments.empty());
}

// A history line out of the form the Parts Tracker takes is pointed out before it is taken: No
// gives the box back with the text to mend, Yes keeps it.
TEST_F(LineListTest, HistoryLinesTheTrackerWouldRefuseAreAskedAbout)
{
    dialogs.expectInput("2008-03-05 [] Changed licence to CC BY 4.0");
    dialogs.expectMessage(Answer::No);
    dialogs.expectInput("2008-03-05 {Jane Doe} Changed licence to CC BY 4.0");
    child<QPushButton>("cmdHistoryAdd")->click();
    ASSERT_EQ(dialogs.inputsShown.size(), 2u);
    EXPECT_EQ(dialogs.inputsShown[1].defaultText, "2008-03-05 [] Changed licence to CC BY 4.0");
    EXPECT_EQ(dialogs.messages.size(), 1u);
    EXPECT_EQ(app.Header.History[3], "2008-03-05 {Jane Doe} Changed licence to CC BY 4.0");
    history->setCurrentRow(3);
    dialogs.expectInput("Changed licence to CC BY 4.0");
    dialogs.expectMessage(Answer::Yes);
    child<QPushButton>("cmdHistoryEdit")->click();
    EXPECT_EQ(dialogs.messages.back().defaultButton, Answer::No);
    EXPECT_EQ(app.Header.History[3], "Changed licence to CC BY 4.0");
}

// The refusal names the preference that lifts the limit.
TEST_F(WindowTest, SaveRefusesALongDescriptionAndSelectsItsTail)
{
    startUp();
    const auto path = part("3001.dat", GoodPart);
    openThroughPendingFile(path);
    auto* description = child<QLineEdit>("txPartDescription");
    // A character beyond the basic plane is one character but two UTF-16 units.
    description->setText(QString::fromUtf8("\xF0\x9F\x98\x80") + QString(69, 'd'));
    description->setFocus();
    QTest::keyClick(description, Qt::Key_End);
    dialogs.expectMessage(Answer::Ok);
    window->MDateiSpeichern_Click();
    EXPECT_EQ(dialogs.messages.back().text,
              "Length of the part description is limited to 64 characters!\r\nSaving the file is not possible\r\n"
              "Option › Preferences › Limit Part Description to 64 characters lifts this limit when it is cleared.");
    EXPECT_EQ(description->selectedText(), QString(6, 'd'));
    EXPECT_EQ(text("lblLength"), "Length: 70");
    EXPECT_EQ(ReadBytes(path), GoodPart);
}

TEST_F(WindowTest, SaveWritesTheComposedHeaderAndBackup)
{
    startUp();
    const auto path = part("3001.dat", GoodPart);
    openThroughPendingFile(path);
    auto* bfc = child<QComboBox>("cbBFCStatement");
    bfc->setCurrentIndex(bfc->findText("CERTIFY CW"));
    EXPECT_TRUE(app.Header.FileChanged);
    window->MDateiSpeichern_Click();
    EXPECT_FALSE(app.Header.FileChanged);
    EXPECT_NE(ReadBytes(path).find("\r\n0 BFC CERTIFY CW\r\n"), std::string::npos);
    EXPECT_EQ(ReadBytes(path), window->newHeaderText() + app.Header.Body + "\r\n");
    EXPECT_EQ(ReadBytes(work.file("3001_Backup_2008-08-10_14-05-09.dat")), GoodPart);
    // From now on the header saved, not the one opened, is what the file holds.
    bfc->setCurrentIndex(bfc->findText("CERTIFY CCW"));
    EXPECT_TRUE(app.Header.FileChanged);
    bfc->setCurrentIndex(bfc->findText("CERTIFY CW"));
    EXPECT_FALSE(app.Header.FileChanged);
}

TEST_F(WindowTest, EveryRoadThatSavesAsksBeforeOverwritingAnotherProgramsChanges)
{
    startUp();
    const auto path = part("3001.dat", GoodPart);
    openThroughPendingFile(path);
    window->show();
    app.Prefs.MakeBackup = false;
    auto* bfc = child<QComboBox>("cbBFCStatement");
    bfc->setCurrentIndex(bfc->findText("CERTIFY CW"));
    const std::string theirs = GoodPart + "1 16 0 0 0 1 0 0 0 1 0 0 0 1 theirs.dat\r\n";
    TempDir::writeTo(path, theirs);

    // Each road that saves asks, and No writes nothing and goes no further.
    dialogs.expectMessage(Answer::No);
    window->MDateiSpeichern_Click();
    EXPECT_EQ(dialogs.messages.back().title, "File Changed on Disk");
    dialogs.expectMessage(Answer::Yes); // the close question
    dialogs.expectMessage(Answer::No);
    EXPECT_FALSE(window->close());
    dialogs.expectMessage(Answer::Yes); // the open question
    dialogs.expectMessage(Answer::No);
    openThroughPendingFile(part("other.dat", "0 Other\r\n"));
    EXPECT_EQ(caption(), "Quillmark 1.0.0 [3001.dat]*");
    EXPECT_EQ(ReadBytes(path), theirs);
    EXPECT_TRUE(app.Header.FileChanged);
}

TEST_F(WindowTest, RecentRoadAsksFirstAndARefusedSaveKeepsTheFile)
{
    startUp();
    openThroughPendingFile(part("3001.dat", GoodPart));
    app.Header.FileChanged = true;
    app.Header.Bfc.clear();
    const auto other = part("other.dat", "0 Other\r\n");
    dialogs.expectMessage(Answer::Yes);
    dialogs.expectMessage(Answer::Ok);
    window->OpenFile(other);
    EXPECT_EQ(dialogs.messages.back().text, RefusalText("You need to set the BFC type!"));
    EXPECT_EQ(caption(), "Quillmark 1.0.0 [3001.dat]");
    dialogs.expectMessage(Answer::No);
    window->OpenFile(other);
    EXPECT_EQ(caption(), "Quillmark 1.0.0 [other.dat]");
}

TEST_F(WindowTest, AFailureInsideAnOpenOrASaveIsReportedAndEndsIt)
{
    startUp();
    dialogs.failNextMessage(); // the box about the removed TAB
    dialogs.expectMessage(Answer::Ok);
    openThroughPendingFile(part("tab.dat", "0 Brick\t2 x 4\r\n0 Author: A\r\n"));
    EXPECT_EQ(dialogs.messages.back().text,
              "Error 51 (Internal error) in procedure MDateiOeffnen_Click of Formular frmMain");
    EXPECT_FALSE(app.Header.Loading);
    EXPECT_EQ(text("lblStatuszeile"), "");

    dialogs.failNextMessage(); // the question about the missing user name
    dialogs.expectMessage(Answer::Ok);
    window->MDateiSpeichern_Click();
    EXPECT_EQ(dialogs.messages.back().text,
              "Error 51 (Internal error) in procedure MDateiSpeichern_Click of Formular frmMain");
}

TEST_F(WindowTest, Latin1FileRefusesCharactersItCannotHold)
{
    startUp();
    const auto path = part("latin.dat", "0 Cran creus\xe9\r\n0 Author: A [a]\r\n");
    openThroughPendingFile(path);
    EXPECT_EQ(text("txPartDescription"), "Cran creus\u00e9");
    auto* description = child<QLineEdit>("txPartDescription");
    description->setFocus();
    description->setCursorPosition(description->text().size());
    dialogs.expectMessage(Answer::Ok);
    typeText(description, QString::fromUtf8("\u20ac"));
    EXPECT_EQ(app.Header.PartDescription, "Cran creus\xe9");
    EXPECT_EQ(description->text().toStdString(), "Cran creus\u00e9");
    QTest::keyClicks(description, "!");
    EXPECT_EQ(app.Header.PartDescription, "Cran creus\xe9!");
}

TEST_F(WindowTest, CommandsArrivingInsideAnOpenWaitOrAreRefused)
{
    startUp();
    window->show();
    const auto path = part("3001.dat", GoodPart);
    // Timers fire while the parser lets the window process pending events.
    QTimer::singleShot(0, window.get(), [this] {
        EXPECT_TRUE(window->openInProgress());
        window->MDateiOeffnen_Click(); // a second open never runs inside the first
        window->MDateiSpeichern_Click();
        window->close(); // closes once the open has ended
        EXPECT_TRUE(window->isVisible());
    });
    openThroughPendingFile(path);
    EXPECT_EQ(caption(), "Quillmark 1.0.0 [3001.dat]");
    EXPECT_FALSE(window->isVisible());
    EXPECT_TRUE(dialogs.fileDialogsShown.empty());
}

} // namespace
