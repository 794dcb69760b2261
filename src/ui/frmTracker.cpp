// SPDX-License-Identifier: MIT
#include "frmTracker.h"

#include <QClipboard>
#include <QGuiApplication>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QKeyEvent>
#include <QLabel>
#include <QPushButton>
#include <QTableWidget>
#include <QVBoxLayout>
#include <algorithm>

#include "TrackerFixes.h"
#include "TwipLayout.h"

namespace {

enum Column { LevelColumn, IdColumn, LineColumn, FixColumn, MessageColumn };

QString counted(long long count, const QString& one, const QString& many) { return count == 1 ? one : many.arg(count); }

long long countOf(const std::vector<StopRow>& rows, bool saveChecks, FindingLevel level)
{
    return std::count_if(rows.begin(), rows.end(), [&](const StopRow& row) {
        return IsSaveCheckRow(row) == saveChecks && row.finding.level == level;
    });
}

// What the rows add up to: whether a save goes through, what the Tracker would say, and whether
// Fix has anything to do.
QString verdict(const std::vector<StopRow>& rows)
{
    if (rows.empty())
        return frmTracker::tr("This part can be saved, and the Parts Tracker's rules find nothing.");
    QStringList sentences;
    if (const auto refusals = countOf(rows, true, FindingLevel::Error); refusals > 0)
        sentences << frmTracker::tr("Save refuses this part: %1.")
                         .arg(counted(refusals, frmTracker::tr("1 error"), frmTracker::tr("%1 errors")));
    const auto errors = countOf(rows, false, FindingLevel::Error);
    const auto warnings = countOf(rows, false, FindingLevel::Warning);
    if (errors > 0)
        sentences << frmTracker::tr("The Parts Tracker would refuse this file: %1.")
                         .arg(counted(errors, frmTracker::tr("1 error"), frmTracker::tr("%1 errors")));
    else if (warnings > 0)
        sentences << frmTracker::tr("The Parts Tracker would accept this file, with the warnings below.");
    else
        sentences << frmTracker::tr("The Parts Tracker's rules find nothing.");
    if (std::none_of(rows.begin(), rows.end(), [](const StopRow& row) { return row.repairable; }))
        sentences << frmTracker::tr("Nothing to fix: no row has a repair that can be made here.");
    return sentences.join(' ');
}

// Errors before warnings, then by id, then by line.
bool listedBefore(const StopRow& a, const StopRow& b)
{
    return std::tie(a.finding.level, a.finding.id, a.finding.line) <
           std::tie(b.finding.level, b.finding.id, b.finding.line);
}

QString messageOf(const StopRow& row)
{
    auto message = QString::fromStdString(row.finding.text);
    if (!row.note.empty())
        message += '\n' + QString::fromStdString(row.note);
    return message;
}

// A line number that sorts as a number; empty for a finding about the whole file, which sorts first.
class LineItem : public QTableWidgetItem {
public:
    explicit LineItem(int line) : QTableWidgetItem(line > 0 ? QString::number(line) : QString()), line_(line) {}
    bool operator<(const QTableWidgetItem& other) const override
    {
        return line_ < static_cast<const LineItem&>(other).line_;
    }

private:
    int line_;
};

} // namespace

frmTracker::frmTracker(const std::vector<StopRow>& rows, const QString& filePath, QWidget* parent, Repairer repair)
    : QDialog(parent), filePath_(filePath), repair_(std::move(repair))
{
    setObjectName("frmTracker");
    setWindowTitle(tr("Check for the Parts Tracker"));
    setModal(true);
    resize(Pixels(9240), Pixels(4200));
    lblVerdict = new QLabel(verdict(rows), this);
    lblVerdict->setObjectName("lblVerdict");
    lblVerdict->setWordWrap(true);
    tbFindings = new QTableWidget(this);
    tbFindings->setObjectName("tbFindings");
    cmdCopy = new QPushButton(tr("&Copy"), this);
    cmdCopy->setObjectName("cmdCopy");
    cmdClose = new QPushButton(tr("C&lose"), this);
    cmdClose->setObjectName("cmdClose");
    cmdClose->setDefault(true);
    auto* buttons = new QHBoxLayout;
    buttons->addStretch();
    addFixButtons(*buttons);
    buttons->addWidget(cmdCopy);
    buttons->addWidget(cmdClose);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(lblVerdict);
    layout->addWidget(tbFindings, 1);
    layout->addLayout(buttons);
    fillTable(rows);
    connect(cmdCopy, &QPushButton::clicked, this, [this] { QGuiApplication::clipboard()->setText(findingsText()); });
    connect(cmdClose, &QPushButton::clicked, this, &QDialog::accept);
    tbFindings->installEventFilter(this);
    connect(tbFindings, &QTableWidget::cellDoubleClicked, this, [this](int row) { findingDoubleClicked(row); });
}

void frmTracker::leadToFields(std::function<bool(const TrackerFinding&)> showField)
{
    showField_ = std::move(showField);
}

void frmTracker::findingDoubleClicked(int row)
{
    if (showField_ && showField_(rowAt(row).finding))
        accept();
}

bool frmTracker::eventFilter(QObject* watched, QEvent* event)
{
    // The table's own Ctrl+C copies one cell.
    if (watched == tbFindings && event->type() == QEvent::KeyPress &&
        static_cast<QKeyEvent*>(event)->matches(QKeySequence::Copy)) {
        copySelectedRows();
        return true;
    }
    return QDialog::eventFilter(watched, event);
}

void frmTracker::copySelectedRows() const
{
    QList<int> rows;
    for (const auto& selected : tbFindings->selectionModel()->selectedRows())
        rows << selected.row();
    std::sort(rows.begin(), rows.end());
    QGuiApplication::clipboard()->setText(rowsText(rows));
}

const StopRow& frmTracker::rowAt(int tableRow) const
{
    const auto index = tbFindings->item(tableRow, LevelColumn)->data(Qt::UserRole).toULongLong();
    return rows_[static_cast<std::size_t>(index)];
}

void frmTracker::fillTable(std::vector<StopRow> rows)
{
    std::stable_sort(rows.begin(), rows.end(), listedBefore);
    rows_ = std::move(rows);
    tbFindings->setSortingEnabled(false); // rows filled again stay where they are put
    tbFindings->setColumnCount(5);
    tbFindings->setHorizontalHeaderLabels({tr("Level"), tr("Id"), tr("Line"), tr("Fix"), tr("Message")});
    tbFindings->setRowCount(static_cast<int>(rows_.size()));
    tbFindings->setTabKeyNavigation(false); // one Tab stop; the arrows move within the table
    tbFindings->setEditTriggers(QAbstractItemView::NoEditTriggers);
    tbFindings->setSelectionBehavior(QAbstractItemView::SelectRows);
    tbFindings->setWordWrap(true);
    tbFindings->verticalHeader()->hide();
    tbFindings->verticalHeader()->setSectionResizeMode(QHeaderView::ResizeToContents);
    tbFindings->horizontalHeader()->setStretchLastSection(true);
    for (int row = 0; row < tbFindings->rowCount(); ++row) {
        const auto& [finding, repairable, note] = rows_[static_cast<std::size_t>(row)];
        auto* level = new QTableWidgetItem(finding.level == FindingLevel::Error ? tr("error") : tr("warning"));
        level->setData(Qt::UserRole, row); // the row's finding, wherever sorting moves the row
        tbFindings->setItem(row, LevelColumn, level);
        tbFindings->setItem(row, IdColumn, new QTableWidgetItem(QString::fromStdString(finding.id)));
        tbFindings->setItem(row, LineColumn, new LineItem(finding.line));
        tbFindings->setItem(row, FixColumn, new QTableWidgetItem(repair_ && repairable ? tr("yes") : QString()));
        tbFindings->setItem(row, MessageColumn, new QTableWidgetItem(messageOf(rows_[static_cast<std::size_t>(row)])));
    }
    // Sorting by level keeps the order within each level: errors first, then by id.
    tbFindings->horizontalHeader()->setSortIndicator(LevelColumn, Qt::AscendingOrder);
    tbFindings->setSortingEnabled(true);
    // Measured with the sort arrow in place, so that no column title is cut.
    for (const auto column : {LevelColumn, IdColumn, LineColumn, FixColumn})
        tbFindings->resizeColumnToContents(column);
    if (tbFindings->rowCount() > 0) // where the focus shows in the table
        tbFindings->setCurrentCell(0, LevelColumn, QItemSelectionModel::NoUpdate);
}

QString frmTracker::findingsText() const
{
    QList<int> rows;
    for (int row = 0; row < tbFindings->rowCount(); ++row)
        rows << row;
    return rowsText(rows);
}

QString frmTracker::rowsText(const QList<int>& rows) const
{
    QString text = filePath_ + '\n';
    for (const int row : rows) {
        const auto line = tbFindings->item(row, LineColumn)->text();
        text += tbFindings->item(row, LevelColumn)->text() + ' ' + tbFindings->item(row, IdColumn)->text() + ": " +
                (line.isEmpty() ? QString() : tr("line %1: ").arg(line)) +
                tbFindings->item(row, MessageColumn)->text() + '\n';
    }
    return text;
}

void frmTracker::addFixButtons(QHBoxLayout& buttons)
{
    if (!repair_)
        return;
    cmdFix = new QPushButton(tr("&Fix"), this);
    cmdFix->setObjectName("cmdFix");
    cmdFixAll = new QPushButton(tr("Fix &All"), this);
    cmdFixAll->setObjectName("cmdFixAll");
    buttons.addWidget(cmdFix);
    buttons.addWidget(cmdFixAll);
    // Tab in reading order: the table, then the buttons from left to right.
    setTabOrder(tbFindings, cmdFix);
    setTabOrder(cmdFix, cmdFixAll);
    setTabOrder(cmdFixAll, cmdCopy);
    connect(cmdFix, &QPushButton::clicked, this, &frmTracker::cmdFix_Click);
    connect(cmdFixAll, &QPushButton::clicked, this, &frmTracker::cmdFixAll_Click);
}

void frmTracker::cmdFix_Click()
{
    std::set<std::string> ids;
    for (const auto& selected : tbFindings->selectionModel()->selectedRows())
        if (const auto& row = rowAt(selected.row()); row.repairable)
            ids.insert(row.finding.id);
    if (!ids.empty())
        showRepaired(ids);
}

void frmTracker::cmdFixAll_Click()
{
    std::set<std::string> ids;
    const auto byDefault = DefaultFixIds();
    for (const auto& row : rows_)
        if (row.repairable && byDefault.contains(row.finding.id))
            ids.insert(row.finding.id);
    if (!ids.empty())
        showRepaired(ids);
}

void frmTracker::showRepaired(const std::set<std::string>& ids)
{
    auto rows = repair_(ids);
    lblVerdict->setText(verdict(rows));
    fillTable(std::move(rows));
}
