// SPDX-License-Identifier: MIT
#include <QAction>
#include <QCheckBox>
#include <QComboBox>
#include <QDropEvent>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QMimeData>
#include <QPushButton>
#include <QRegularExpression>
#include <QScreen>
#include <QTableWidget>
#include <QTest>
#include <filesystem>

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
    const QFont designFont = QApplication::font();
    for (const double points : {8.0, 14.0}) {
        QFont font = designFont;
        font.setPointSizeF(points);
        QApplication::setFont(font);
        startUp();
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
    }
    QApplication::setFont(designFont);
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
    EXPECT_NE(window->newHeaderText().find("0 Author: Jane Doe\r\n"), std::string::npos);
    EXPECT_TRUE(app.Header.FileChanged);
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

TEST_F(WindowTest, RecentFileThatWasDeletedIsReportedAndStays)
{
    startUp();
    const auto a = part("a.dat", "0 A\r\n"), b = part("b.dat", "0 B\r\n");
    openThroughPendingFile(a);
    openThroughPendingFile(b);
    std::filesystem::remove(a);
    dialogs.expectMessage(Answer::Ok);
    dialogs.expectMessage(Answer::Ok);
    child<QAction>("MRecentFile_2")->trigger();
    EXPECT_EQ(dialogs.messages.back().text, "File " + a + " not found!");
    EXPECT_EQ(child<QAction>("MRecentFile_2")->text().toStdString(), a);
    EXPECT_EQ(caption(), "Quillmark 1.0.0 [b.dat]") << "the open file stays";
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
// saved, it holds what quillmark-cli fix writes into a copy of the file.
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
    const auto fix = QUILLMARK_PROGRAM_FOLDER "/quillmark-cli fix --no-backup --quiet '" + copy + "' >/dev/null";
    ASSERT_EQ(std::system(fix.c_str()), 0);
    EXPECT_EQ(ReadBytes(path), ReadBytes(copy));
}

} // namespace
