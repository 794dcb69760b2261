// SPDX-License-Identifier: MIT
// The Tracker dialog as one list of what stops a save: the save checks beside the Parts Tracker's
// findings, with what lifts each, and repairs marked only where they can be made.
#include <QAction>
#include <QLabel>
#include <QPushButton>
#include <QTableWidget>
#include <QTest>

#include "WindowFixture.h"
#include "frmTracker.h"

namespace {

enum Column { LevelColumn, IdColumn, LineColumn, FixColumn, MessageColumn };

int rowOf(const QTableWidget& table, const char* id)
{
    const auto found = table.findItems(id, Qt::MatchExactly);
    return found.size() == 1 ? found[0]->row() : -1;
}

QString verdictOf(const frmTracker& dialog) { return dialog.findChild<QLabel*>("lblVerdict")->text(); }

const std::string LongDescription = "Brick  2 x 4 with a description that runs on well past its sixty-four characters";

// A description past 64 characters is listed as the save's refusal, with the preference that
// lifts it, and no repair; a double-click leads to the description.
TEST_F(WindowTest, TheTrackerDialogListsTheSavesRefusalAndWhatLiftsIt)
{
    startUp();
    auto longer = GoodPart;
    longer.replace(longer.find("Brick  2 x 4"), 12, LongDescription);
    openThroughPendingFile(part("3001.dat", longer));
    window->activateWindow();
    ASSERT_TRUE(QTest::qWaitForWindowActive(window.get()));
    whenDialogShows<frmTracker>([](frmTracker& dialog) {
        auto& table = *dialog.findChild<QTableWidget*>("tbFindings");
        const int row = std::max(rowOf(table, "save.description-length"), 0);
        EXPECT_EQ(table.item(row, IdColumn)->text(), "save.description-length");
        EXPECT_EQ(table.item(row, LevelColumn)->text(), "error");
        EXPECT_EQ(table.item(row, FixColumn)->text(), "");
        EXPECT_TRUE(table.item(row, MessageColumn)->text().contains("Length of the part description is limited"));
        EXPECT_TRUE(table.item(row, MessageColumn)
                        ->text()
                        .contains("Limit Part Description to 64 characters in Option › Preferences"));
        EXPECT_TRUE(verdictOf(dialog).startsWith("Save refuses this part: 1 error."));
        const QPoint cell = table.visualItemRect(table.item(row, IdColumn)).center();
        QTest::mouseClick(table.viewport(), Qt::LeftButton, {}, cell);
        QTest::mouseDClick(table.viewport(), Qt::LeftButton, {}, cell);
        EXPECT_FALSE(dialog.isVisible());
        dialog.reject();
    });
    child<QAction>("MTrackerCheck")->trigger();
    EXPECT_EQ(window->focusWidget(), child<QWidget>("txPartDescription"));
}

// A retired category that no active one follows from has a repair that cannot be made here: no
// Fix mark, the reason in its row, and "Nothing to fix" once no row has a repair. A part with no
// row at all can be saved, and the dialog says so.
TEST_F(WindowTest, ARepairThatCannotBeMadeHasNoMarkAndSaysWhy)
{
    startUp();
    auto retired = GoodPart;
    retired.replace(retired.find("Brick  2 x 4"), 12, "Thing")
        .replace(retired.find("!CATEGORY Brick"), 15, "!CATEGORY Grab");
    openThroughPendingFile(part("3001.dat", retired));
    whenDialogShows<frmTracker>([](frmTracker& dialog) {
        auto& table = *dialog.findChild<QTableWidget*>("tbFindings");
        dialog.reject(); // closes it also when a check below fails
        EXPECT_EQ(table.rowCount(), 1);
        const int row = rowOf(table, "warning.minifigcategory");
        EXPECT_EQ(row, 0);
        if (row == 0) {
            EXPECT_EQ(table.item(row, FixColumn)->text(), "");
            EXPECT_TRUE(table.item(row, MessageColumn)->text().contains("needs a category chosen by hand"));
        }
        EXPECT_TRUE(verdictOf(dialog).contains("Nothing to fix"));
    });
    child<QAction>("MTrackerCheck")->trigger();

    auto numbers = GoodPart;
    openThroughPendingFile(part("3002.dat", numbers.replace(numbers.find("3001.dat"), 8, "3002.dat")));
    whenDialogShows<frmTracker>([](frmTracker& dialog) {
        auto& table = *dialog.findChild<QTableWidget*>("tbFindings");
        EXPECT_EQ(rowOf(table, "warning.descriptionnumbers"), 0);
        EXPECT_EQ(table.item(0, FixColumn)->text(), "yes");
        EXPECT_FALSE(verdictOf(dialog).contains("Nothing to fix")) << "a row has a repair";
        dialog.findChild<QPushButton*>("cmdFixAll")->click();
        EXPECT_EQ(table.rowCount(), 0);
        EXPECT_EQ(verdictOf(dialog), "This part can be saved, and the Parts Tracker's rules find nothing.");
        dialog.findChild<QPushButton*>("cmdClose")->click();
    });
    child<QAction>("MTrackerCheck")->trigger();
}

// The count after a save includes the save checks' warnings: a part without a user name saves
// after the question, and its status line counts that.
TEST_F(WindowTest, TheCountAfterASaveIncludesTheSaveChecks)
{
    startUp();
    auto noUser = GoodPart;
    noUser.replace(noUser.find(" [ssample]"), 10, "");
    openThroughPendingFile(part("3001.dat", noUser));
    app.Prefs.MakeBackup = false;
    child<QWidget>("txPartDescription")->setFocus();
    QTest::keyClick(child<QWidget>("txPartDescription"), Qt::Key_End);
    QTest::keyClicks(child<QWidget>("txPartDescription"), "x");
    dialogs.expectMessage(Answer::Yes); // save without a user name
    window->MDateiSpeichern_Click();
    EXPECT_EQ(text("lblStatuszeile"), "Saved " + app.Header.FilePath + "; Checks: 1 warning (Ctrl+T)");
}

} // namespace

namespace {

// Lines are the file's on disk, as grep -n and the command line count them: after a comment that
// holds a lone CR, which the Tracker's rules take as a line end, and below a header that the
// composer lays out anew.
TEST_F(WindowTest, TheDialogsLineNumbersAreTheFilesOnDisk)
{
    startUp();
    auto numbered = GoodPart;
    numbered.replace(numbered.find("2 x 4"), 5, "2 x  4");
    openThroughPendingFile(part("3001.dat", numbered + "0 // a lone\rCR\r\n"));
    whenDialogShows<frmTracker>([](frmTracker& dialog) {
        dialog.reject();
        auto& table = *dialog.findChild<QTableWidget*>("tbFindings");
        const int row = rowOf(table, "line.invalid");
        EXPECT_EQ(row, 0);
        if (row == 0) {
            EXPECT_EQ(table.item(row, LineColumn)->text(), "16");
        }
    });
    child<QAction>("MTrackerCheck")->trigger();
}

} // namespace
