// SPDX-License-Identifier: MIT
#include <QAction>
#include <QCheckBox>
#include <QComboBox>
#include <QDropEvent>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QMenuBar>
#include <QMimeData>
#include <QPushButton>
#include <QRegularExpression>
#include <QScreen>
#include <QTableWidget>
#include <QTest>
#include <filesystem>
#include <map>
#include <sys/stat.h>

#include "StandardLists.h"
#include "WindowFixture.h"
#include "frmList.h"
#include "frmOption.h"
#include "frmTracker.h"

namespace {

void clickRow(QListWidget& list, const QString& text)
{
    const auto items = list.findItems(text, Qt::MatchExactly);
    ASSERT_FALSE(items.isEmpty()) << text.toStdString();
    list.setCurrentItem(items.first());
}

class ListMenuTest : public WindowTest {
protected:
    void SetUp() override
    {
        startUp();
        openThroughPendingFile(part("3001.dat", GoodPart));
    }
    std::string listFile(ListKind kind) const { return ReadBytes(ListFilePath(app.ProgramFolder, kind)); }
};

TEST_F(ListMenuTest, AddingACategoryWritesTheFileAndRefillsTheList)
{
    dialogs.expectMessage(Answer::Yes);
    dialogs.expectInput("  technic BEAM ");
    dialogs.expectMessage(Answer::Yes);
    whenDialogShows<frmList>([&](frmList& dialog) {
        dialog.findChild<QPushButton*>("cmdAdd")->click();
        EXPECT_TRUE(RowsOf(*dialog.findChild<QListWidget*>("lsValues")).contains("Technic Beam"));
        dialog.findChild<QPushButton*>("cmdClose")->click();
    });
    window->MEditCategory_Click();
    EXPECT_EQ(dialogs.messages.back().title, "Changed Categories");
    EXPECT_NE(listFile(ListKind::Category).find("Technic\r\nTechnic Beam\r\nTile\r\n"), std::string::npos);
    auto* combo = child<QComboBox>("cbCategory");
    EXPECT_NE(combo->findText("Technic Beam"), -1);
    EXPECT_EQ(combo->currentIndex(), -1);
    EXPECT_EQ(app.Header.Category, "Brick");
}

TEST_F(ListMenuTest, EscapePressesCloseWhichAsksAfterAnUpdate)
{
    whenDialogShows<frmList>([&](frmList& dialog) { QTest::keyClick(&dialog, Qt::Key_Escape); });
    window->MEditPartTyps_Click();
    EXPECT_EQ(app.Header.PartType, "Part");

    const auto before = listFile(ListKind::Bfc);
    dialogs.expectMessage(Answer::No);
    whenDialogShows<frmList>([&](frmList& dialog) {
        clickRow(*dialog.findChild<QListWidget*>("lsValues"), "NOCERTIFY");
        auto* update = dialog.findChild<QLineEdit*>("txUpdate");
        update->setText("");
        emit update->textEdited("certify ccw noclip");
        dialog.findChild<QPushButton*>("cmdChange")->click();
        EXPECT_TRUE(RowsOf(*dialog.findChild<QListWidget*>("lsValues")).contains("CERTIFY CCW NOCLIP"));
        QTest::keyClick(&dialog, Qt::Key_Escape);
    });
    window->MEditBFCStatement_Click();
    EXPECT_EQ(dialogs.messages.back().text, "Do you want to save the changes to the list?");
    EXPECT_EQ(listFile(ListKind::Bfc), before);
}

TEST_F(ListMenuTest, TrackerCheckShowsTheFindingsAndChangesNothing)
{
    const auto before = app.Header;
    whenDialogShows<frmTracker>([](frmTracker& dialog) {
        auto* table = dialog.findChild<QTableWidget*>("tbFindings");
        ASSERT_EQ(table->rowCount(), 1);
        EXPECT_EQ(table->item(0, 0)->text(), "warning");
        EXPECT_EQ(table->item(0, 1)->text(), "warning.descriptionnumbers");
        EXPECT_NE(dialog.findChild<QLabel*>("lblVerdict")->text().indexOf("accept"), -1);
        dialog.findChild<QPushButton*>("cmdClose")->click();
    });
    child<QAction>("MTrackerCheck")->trigger();
    EXPECT_EQ(app.Header.Body, before.Body);
    EXPECT_FALSE(app.Header.FileChanged);
}

// Ctrl+T opens the Tracker's findings; a double-click on one about the header closes them and puts
// the focus in its field. After a save the status line tells what the Tracker would say.
TEST_F(WindowTest, TrackerFindingsLeadToTheirFieldsAndEverySaveCountsThem)
{
    startUp();
    auto refused = GoodPart;
    refused.replace(refused.find("CERTIFY CCW"), 11, "CERTIFY CW").replace(refused.find("Licensed under"), 14, "Mine");
    openThroughPendingFile(part("3001.dat", refused));
    window->activateWindow();
    ASSERT_TRUE(QTest::qWaitForWindowActive(window.get()));
    child<QWidget>("txAuthorUserName")->setFocus();
    whenDialogShows<frmTracker>([](frmTracker& dialog) {
        auto* table = dialog.findChild<QTableWidget*>("tbFindings");
        const auto licence = table->findItems("license.approved", Qt::MatchExactly);
        ASSERT_EQ(licence.size(), 1);
        const QPoint finding = table->visualItemRect(licence[0]).center();
        QTest::mouseClick(table->viewport(), Qt::LeftButton, {}, finding); // a double-click's first click
        QTest::mouseDClick(table->viewport(), Qt::LeftButton, {}, finding);
        EXPECT_FALSE(dialog.isVisible());
        dialog.reject(); // ends the test rather than waiting, should the double-click not have closed it
    });
    QTest::keyClick(window.get(), Qt::Key_T, Qt::ControlModifier);
    EXPECT_EQ(window->focusWidget(), child<QWidget>("cbLicenses"));
    app.Prefs.MakeBackup = false;
    window->MDateiSpeichern_Click();
    EXPECT_EQ(text("lblStatuszeile"), "Saved " + app.Header.FilePath + "; Parts Tracker: 2 errors, 1 warning (Ctrl+T)");
}

// Two controls of one parent that cover each other by more than the design's own one-pixel
// touches, grown with the font.
bool overlap(const QWidget& a, const QWidget& b)
{
    const QRect both = a.geometry().intersected(b.geometry());
    return both.width() > 2 && both.height() > 2;
}

// Every caption shows whole in the window font, at the design's 8 pt and at 14 pt: its text is no
// wider than the room the control leaves it, the control lies inside its window and covers no
// other, and the main window stays on the screen.
TEST_F(WindowTest, EveryCaptionOfTheThreeWindowsShowsWholeAtAnyFontSize)
{
    atDesignAndLargeFont([this](double points) {
        frmList list(ListKind::Category, {"<none>"}, app.ProgramFolder, dialogs);
        frmOption options(PreferencesForm{}, {});
        for (const QWidget* shown : std::initializer_list<const QWidget*>{window.get(), &list, &options}) {
            const auto controls =
                shown->findChildren<QWidget*>(QRegularExpression("^(Label|lbl|tx|cb|ls|cmd|chk|Frame)"));
            for (const auto* control : controls) {
                const auto name = control->objectName().toStdString() + " at " + std::to_string(points) + " pt";
                EXPECT_LE(control->geometry().right(), control->parentWidget()->width() - 1) << name;
                for (const auto* other : controls) {
                    if (other < control && other->parentWidget() == control->parentWidget()) {
                        EXPECT_FALSE(overlap(*control, *other))
                            << name << " covers " << other->objectName().toStdString();
                    }
                }
            }
            for (const auto* label : shown->findChildren<QLabel*>())
                EXPECT_LE(label->fontMetrics().horizontalAdvance(label->text()), label->contentsRect().width())
                    << label->objectName().toStdString() << " at " << points << " pt";
            for (const auto* button : shown->findChildren<QAbstractButton*>()) {
                const auto caption = QString(button->text()).remove('&');
                const int indicator = qobject_cast<const QCheckBox*>(button) ? 20 : 0;
                EXPECT_LE(button->fontMetrics().horizontalAdvance(caption) + indicator + 4, button->width())
                    << button->objectName().toStdString() << " at " << points << " pt";
            }
        }
        const QSize screen = window->screen()->availableGeometry().size();
        EXPECT_LE(window->height(), screen.height()) << points << " pt";
        EXPECT_LE(window->width(), screen.width()) << points << " pt";
    });
}

// The window grows from its design size: the lists and the old header take the room, the controls
// beside and below them move along, the others keep their places, and nothing covers anything.
TEST_F(WindowTest, AGrownWindowGivesItsRoomToTheListsAndTheOldHeader)
{
    atDesignAndLargeFont([this](double points) {
        const auto* client = child<QWidget>("client");
        const auto controls = client->findChildren<QWidget*>(QRegularExpression("^(Label|lbl|tx|cb|ls|cmd)"));
        window->resize(client->minimumSize() + QSize(0, window->menuBar()->height()));
        QApplication::processEvents();
        std::map<const QWidget*, QRect> design;
        for (const auto* control : controls)
            design[control] = control->geometry();
        window->resize(window->size() + QSize(400, 300));
        QApplication::processEvents();
        ASSERT_EQ(client->size(), client->minimumSize() + QSize(400, 300));
        for (const auto* control : controls) {
            const auto name = control->objectName().toStdString() + " at " + std::to_string(points) + " pt";
            const QRect before = design[control];
            const bool grows = QRegularExpression("^(ls|txOldHeader)").match(control->objectName()).hasMatch();
            if (grows) {
                EXPECT_TRUE(control->width() > before.width() && control->height() > before.height()) << name;
            } else if (control != child<QWidget>("lblStatuszeile")) {
                EXPECT_EQ(control->size(), before.size()) << name;
            }
            if (control->y() < child<QWidget>("lsKeyWords")->y()) {
                EXPECT_EQ(control->pos(), before.topLeft()) << name << " above the lists stays";
            }
            EXPECT_LE(control->geometry().right(), client->width() - 1) << name;
            for (const auto* other : controls)
                EXPECT_FALSE(other < control && overlap(*control, *other))
                    << name << " covers " << other->objectName().toStdString();
        }
        EXPECT_GT(child<QWidget>("lsComments")->x(), child<QWidget>("cmdEdit")->geometry().right());
        window->resize(100, 100);
        EXPECT_EQ(window->size(), window->minimumSize()) << "no smaller than its design, or the screen";
    });
}

TEST_F(WindowTest, AGrownListDialogGivesItsRoomToTheList)
{
    frmList dialog(ListKind::Bfc, {"CERTIFY CCW"}, app.ProgramFolder, dialogs);
    dialog.show();
    QApplication::processEvents();
    auto* values = dialog.findChild<QListWidget*>("lsValues");
    auto* close = dialog.findChild<QPushButton*>("cmdClose");
    const QSize before = values->size();
    const int closeLeft = close->x();
    dialog.resize(dialog.size() + QSize(200, 150));
    QApplication::processEvents();
    EXPECT_EQ(values->size(), before + QSize(200, 150));
    EXPECT_EQ(close->x(), closeLeft + 200) << "the buttons keep to the list's right";
}

TEST_F(WindowTest, PreferencesWindowWithAnEmptyStore)
{
    startUp();
    whenDialogShows<frmOption>([&](frmOption& dialog) {
        EXPECT_EQ(dialog.findChild<QLineEdit*>("txRealName")->text(), "");
        EXPECT_EQ(dialog.findChild<QComboBox*>("cbLicenses")->currentIndex(), -1);
        EXPECT_TRUE(dialog.findChild<QCheckBox*>("chkBackup")->isChecked());
        EXPECT_TRUE(dialog.findChild<QCheckBox*>("chkDescriptionLimit")->isChecked());
        dialog.findChild<QCheckBox*>("chkDescriptionLimit")->setChecked(false);
        dialog.findChild<QLineEdit*>("txRealName")->setText("  Jane Doe ");
        dialog.findChild<QPushButton*>("cmdSave")->click();
    });
    window->MEinstellDefault_Click();
    EXPECT_EQ(store.read(DefaultGroup, "RealName", ""), "Jane Doe");
    EXPECT_EQ(store.read(DefaultGroup, "Liscense", "?"), "");
    EXPECT_EQ(store.read(DefaultGroup, "Backup", ""), "True");
    EXPECT_EQ(store.read(DefaultGroup, "DescriptionLimit", ""), "False");
    EXPECT_FALSE(app.Prefs.LimitDescription);
}

// While no name is stored, the preferences window is offered with what the names are for; its
// Cancel stores nothing, and once a name is stored nothing is offered.
TEST_F(WindowTest, PreferencesAreOfferedWhileTheyHoldNoName)
{
    startUp();
    for (const bool nameStored : {false, true}) {
        bool shown = false;
        whenDialogShows<frmOption>([&](frmOption& dialog) {
            shown = true;
            EXPECT_NE(dialog.findChild<QLabel*>("lblNamesUse")->text().indexOf("Author line"), -1);
            dialog.findChild<QPushButton*>("cmdCancel")->click();
        });
        window->OfferPreferencesWithoutNames();
        EXPECT_EQ(shown, !nameStored);
        if (!nameStored) {
            EXPECT_FALSE(store.read(DefaultGroup, "RealName").has_value()) << "Cancel stores nothing";
        }
        store.write(DefaultGroup, "UserName", "jdoe");
    }
}

TEST_F(WindowTest, SetPreferencesShowsTheDefaultsInTheWindow)
{
    store.write(DefaultGroup, "RealName", "Jane Doe");
    store.write(DefaultGroup, "Liscense", "Marked with CC0 1.0 : see CAreadme.txt");
    startUp();
    openThroughPendingFile(part("3001.dat", GoodPart));
    dialogs.expectMessage(Answer::Yes);
    window->cmdSetPreferences_Click();
    EXPECT_EQ(text("txAuthorRealName"), "Jane Doe");
    EXPECT_EQ(child<QComboBox>("cbLicenses")->currentText(), "Marked with CC0 1.0 : see CAreadme.txt");
    EXPECT_NE(window->newHeaderText().find("0 Author: Jane Doe [ssample]\r\n"), std::string::npos)
        << "the user name that the preferences lack stays";
    EXPECT_TRUE(app.Header.FileChanged);
}

TEST_F(WindowTest, SetPreferencesWithoutStoredNamesSaysSoAndKeepsTheFields)
{
    startUp();
    openThroughPendingFile(part("3001.dat", GoodPart));
    dialogs.expectMessage(Answer::Ok);
    window->cmdSetPreferences_Click();
    EXPECT_EQ(dialogs.messages.back().text.find("Your preferences hold no name yet"), 0u);
    EXPECT_EQ(text("txAuthorRealName"), "Sam Sample");
    EXPECT_EQ(text("txAuthorUserName"), "ssample");
    EXPECT_FALSE(app.Header.FileChanged);
}

TEST_F(WindowTest, RecentFilesMenuShowsTheStoredFilesNewestFirstAndAClickOpens)
{
    store.write(RecentFilesGroup, "RecentFile1", "/parts/from-an-earlier-run.dat");
    startUp();
    // "&" is part of a file's name, not an access key.
    const auto a = part("a&b.dat", "0 A\r\n"), b = part("b.dat", "0 B\r\n"), c = part("c.dat", "0 C\r\n");
    for (const auto& path : {a, b, c})
        openThroughPendingFile(path);
    EXPECT_EQ(child<QAction>("MRecentFile_1")->text().toStdString(), c);
    EXPECT_EQ(child<QAction>("MRecentFile_4")->text(), "/parts/from-an-earlier-run.dat");
    EXPECT_EQ(child<QAction>("MRecentFile_3")->text(), QString::fromStdString(a).replace("&", "&&"));
    child<QAction>("MRecentFile_3")->trigger();
    EXPECT_EQ(text("txPartDescription"), "A");
}

// A file that cannot be opened is named in one box with the system's reason, and the file that
// was open stays; a deleted recent file keeps its entry.
TEST_F(WindowTest, FilesThatCannotBeOpenedAreNamedWithTheReasonAndTheOpenFileStays)
{
    startUp();
    const auto a = part("a.dat", "0 A\r\n"), b = part("b.dat", "0 B\r\n");
    openThroughPendingFile(a);
    openThroughPendingFile(b);
    std::filesystem::remove(a);
    const auto fifo = work.file("fifo.dat");
    ASSERT_EQ(::mkfifo(fifo.c_str(), 0600), 0);
    const std::pair<std::string, std::string> cases[] = {
        {a, "Error 53 (File not found) in procedure IsUnixLineEnd of Modul modUNIX\r\n" + a +
                ": No such file or directory"},
        {work.path().string(), "Error 75 (Path/File access error) in procedure IsUnixLineEnd of Modul modUNIX\r\n" +
                                   work.path().string() + ": Is a directory"},
        {fifo, "Error 75 (Path/File access error) in procedure IsUnixLineEnd of Modul modUNIX\r\n" + fifo +
                   ": Not a regular file"}};
    for (const auto& [path, report] : cases) {
        dialogs.expectMessage(Answer::Ok);
        path == a ? child<QAction>("MRecentFile_2")->trigger() : openThroughPendingFile(path);
        ASSERT_EQ(dialogs.messages.size(), 1u) << path;
        EXPECT_EQ(dialogs.messages.back().text, report);
        dialogs.messages.clear();
        EXPECT_EQ(caption(), "Quillmark 1.0.0 [b.dat]") << "the open file stays";
    }
    EXPECT_EQ(child<QAction>("MRecentFile_2")->text().toStdString(), a);
}

// Paths named relative to the working folder are remembered in full, so that the recent files
// and the Open dialog still find them when the program starts from another folder. Of several
// files dropped, the first opens; dropped text is no file.
TEST_F(WindowTest, RelativePathsFromTheCommandLineAndDropsAreMadeFull)
{
    part("a.dat", "0 A\r\n");
    part("b.dat", "0 B\r\n");
    const auto previous = std::filesystem::current_path();
    std::filesystem::create_directory(work.path() / "sub");
    std::filesystem::current_path(work.path() / "sub");
    startUp({"../a.dat"});
    EXPECT_EQ(app.Header.FilePath, (work.path() / "sub/../a.dat").string());
    QMimeData files;
    files.setUrls({QUrl::fromLocalFile("./../b.dat"), QUrl::fromLocalFile("../a.dat")});
    Drop(*window, files);
    QMimeData text;
    text.setText("../a.dat");
    Drop(*window, text);
    std::filesystem::current_path(previous);
    EXPECT_EQ(app.Header.FilePath, (work.path() / "sub/../b.dat").string());
    EXPECT_EQ(store.read(RecentFilesGroup, "RecentFile1", ""), app.Header.FilePath);
    EXPECT_EQ(store.read(RecentFilesGroup, "RecentFile2", ""), (work.path() / "sub/../a.dat").string());
    EXPECT_EQ(store.read(DefaultGroup, "LastPath", ""), (work.path() / "sub/..").string());
}

} // namespace

namespace {

// Fix on a row and Fix All in the Tracker dialog change the open document only, the body too;
// saved, it holds what quillmark-cli fix --recompose writes into a copy of the file.
TEST_F(WindowTest, FixAllInTheTrackerDialogThenSaveWritesWhatFixWrites)
{
    auto old = GoodPart + "3 16 1.0 0 0 0 1 0 0 0 1.1234567\r\n";
    old.replace(old.find("Licensed under CC BY 4.0"), 24, "Redistributable under CCAL version 2.0");
    startUp();
    std::filesystem::create_directory(work.file("copy"));
    const auto path = part("3001.dat", old), copy = part("copy/3001.dat", old);
    openThroughPendingFile(path);
    whenDialogShows<frmTracker>([](frmTracker& dialog) { // the body alone, by Fix on its row
        auto* table = dialog.findChild<QTableWidget*>("tbFindings");
        EXPECT_EQ(table->rowCount(), 4);
        EXPECT_EQ(table->item(0, 3)->text(), "yes");
        table->selectRow(static_cast<int>(table->findItems("numbers.trailingzeros", Qt::MatchExactly)[0]->row()));
        dialog.findChild<QPushButton*>("cmdFix")->click();
        EXPECT_EQ(table->rowCount(), 3);
        dialog.findChild<QPushButton*>("cmdClose")->click();
    });
    child<QAction>("MTrackerCheck")->trigger();
    EXPECT_NE(caption().find('*'), std::string::npos);
    whenDialogShows<frmTracker>([](frmTracker& dialog) {
        dialog.findChild<QPushButton*>("cmdFixAll")->click();
        EXPECT_EQ(dialog.findChild<QTableWidget*>("tbFindings")->rowCount(), 0);
        dialog.findChild<QPushButton*>("cmdClose")->click();
    });
    child<QAction>("MTrackerCheck")->trigger();
    EXPECT_EQ(ReadBytes(path), old) << "nothing saved before Save";
    window->MDateiSpeichern_Click();
    const auto fix =
        QUILLMARK_PROGRAM_FOLDER "/quillmark-cli fix --recompose --no-backup --quiet '" + copy + "' >/dev/null";
    ASSERT_EQ(std::system(fix.c_str()), 0);
    EXPECT_EQ(ReadBytes(path), ReadBytes(copy));
}

} // namespace
