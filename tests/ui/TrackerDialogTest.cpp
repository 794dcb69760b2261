// SPDX-License-Identifier: MIT
// The Parts Tracker dialog: its table's order, sorting, growing, and copying.
#include <QApplication>
#include <QClipboard>
#include <QHeaderView>
#include <QPushButton>
#include <QTableWidget>
#include <QTest>
#include <gtest/gtest.h>
#include <set>

#include "frmTracker.h"

namespace {

const std::string LongMessage = "The quad is not quite flat: it bends by 2.430 degrees, which the library accepts "
                                "with a warning but would rather see split into two triangles.";

const std::vector<StopRow> Findings = {
    {{"warning.notcoplaner", FindingLevel::Warning, LongMessage, 12}, false, {}},
    {{"line.invalid", FindingLevel::Error, "Not a valid LDraw line.", 30}, false, {}},
    {{"bfc", FindingLevel::Error, "The first BFC line is missing.", 0}, false, {}},
    {{"line.colinear", FindingLevel::Error, "On one line.", 9}, false, {}}};

QStringList column(const QTableWidget& table, int column)
{
    QStringList texts;
    for (int row = 0; row < table.rowCount(); ++row)
        texts << table.item(row, column)->text();
    return texts;
}

void clickHeader(QTableWidget& table, int section)
{
    auto* header = table.horizontalHeader();
    QTest::mouseClick(
        header->viewport(), Qt::LeftButton, {},
        QPoint(header->sectionViewportPosition(section) + header->sectionSize(section) / 2, header->height() / 2));
}

TEST(TrackerDialog, ListsErrorsFirstAndSortsByTheClickedColumn)
{
    frmTracker dialog(Findings, "/parts/3001.dat");
    dialog.show();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(&dialog));
    auto& table = *dialog.findChild<QTableWidget*>("tbFindings");
    EXPECT_EQ(column(table, 1), QStringList({"bfc", "line.colinear", "line.invalid", "warning.notcoplaner"}));
    clickHeader(table, 2);
    EXPECT_EQ(column(table, 2), QStringList({"", "9", "12", "30"}));
    clickHeader(table, 2);
    EXPECT_EQ(column(table, 2), QStringList({"30", "12", "9", ""}));
}

// After sorting, a double-click hands on the finding of the row as it now stands.
TEST(TrackerDialog, ADoubleClickAfterSortingLeadsToThatRowsFinding)
{
    frmTracker dialog(Findings, "/parts/3001.dat");
    std::vector<std::string> ledTo;
    dialog.leadToFields([&ledTo](const TrackerFinding& finding) {
        ledTo.push_back(finding.id);
        return false;
    });
    dialog.show();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(&dialog));
    auto& table = *dialog.findChild<QTableWidget*>("tbFindings");
    clickHeader(table, 2);
    clickHeader(table, 2); // lines from the last: 30, 12, 9, none
    for (const int row : {0, 1}) {
        const QPoint cell = table.visualItemRect(table.item(row, 1)).center();
        QTest::mouseClick(table.viewport(), Qt::LeftButton, {}, cell);
        QTest::mouseDClick(table.viewport(), Qt::LeftButton, {}, cell);
    }
    EXPECT_EQ(ledTo, std::vector<std::string>({"line.invalid", "warning.notcoplaner"}));
}

// Tab stops once in the table (the arrows move within it), then at each button, each with its
// access key; the table shows where its focus is.
TEST(TrackerDialog, TabStopsOnceInTheTableThenAtEachButton)
{
    frmTracker dialog(Findings, "/parts/3001.dat", nullptr, [](const std::set<std::string>&) { return Findings; });
    dialog.show();
    ASSERT_TRUE(QTest::qWaitForWindowExposed(&dialog));
    auto& table = *dialog.findChild<QTableWidget*>("tbFindings");
    table.setFocus();
    QStringList walked;
    for (int step = 0; step < 5; ++step) {
        walked << QApplication::focusWidget()->objectName();
        QTest::keyClick(QApplication::focusWidget(), Qt::Key_Tab);
    }
    EXPECT_EQ(walked, QStringList({"tbFindings", "cmdFix", "cmdFixAll", "cmdCopy", "cmdClose"}));
    EXPECT_EQ(QApplication::focusWidget(), &table) << "round again";
    EXPECT_TRUE(table.currentIndex().isValid()) << "a current cell, where the focus shows";
    for (const char* name : {"cmdFix", "cmdFixAll", "cmdCopy", "cmdClose"})
        EXPECT_TRUE(dialog.findChild<QPushButton*>(name)->text().contains('&')) << name;
}

TEST(TrackerDialog, GrowsWithTheTableAndWrapsLongMessages)
{
    frmTracker dialog(Findings, "/parts/3001.dat");
    dialog.show();
    auto& table = *dialog.findChild<QTableWidget*>("tbFindings");
    ASSERT_TRUE(QTest::qWaitForWindowExposed(&dialog));
    const auto before = table.size();
    dialog.resize(dialog.width() + 200, dialog.height() + 100);
    QApplication::processEvents();
    EXPECT_EQ(table.size(), before + QSize(200, 100));
    const int longRow = 3; // the warning, listed last
    dialog.resize(3000, dialog.height());
    QApplication::processEvents();
    EXPECT_EQ(table.rowHeight(longRow), table.rowHeight(0)) << "room enough for one line";
    dialog.resize(500, dialog.height());
    QApplication::processEvents();
    EXPECT_GT(table.rowHeight(longRow), table.rowHeight(0)) << "the long message wraps";
}

TEST(TrackerDialog, CopyPutsThePathAndEveryFindingOnTheClipboard)
{
    frmTracker dialog(Findings, "/parts/3001.dat");
    QApplication::clipboard()->clear();
    dialog.findChild<QPushButton*>("cmdCopy")->click();
    EXPECT_EQ(QApplication::clipboard()->text(), "/parts/3001.dat\n"
                                                 "error bfc: The first BFC line is missing.\n"
                                                 "error line.colinear: line 9: On one line.\n"
                                                 "error line.invalid: line 30: Not a valid LDraw line.\n"
                                                 "warning warning.notcoplaner: line 12: " +
                                                     QString::fromStdString(LongMessage) + "\n");
}

TEST(TrackerDialog, CtrlCCopiesTheSelectedRowsAsCopyWordsThem)
{
    frmTracker dialog(Findings, "/parts/3001.dat");
    auto& table = *dialog.findChild<QTableWidget*>("tbFindings");
    table.selectRow(3);
    table.selectionModel()->select(table.model()->index(0, 2), QItemSelectionModel::Select | QItemSelectionModel::Rows);
    QTest::keyClick(&table, Qt::Key_C, Qt::ControlModifier);
    EXPECT_EQ(QApplication::clipboard()->text(), "/parts/3001.dat\n"
                                                 "error bfc: The first BFC line is missing.\n"
                                                 "warning warning.notcoplaner: line 12: " +
                                                     QString::fromStdString(LongMessage) + "\n");
}

} // namespace
