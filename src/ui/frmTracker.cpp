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

bool hasRepair(const QString& id)
{
    const auto& fixes = TrackerFixes();
    return std::any_of(fixes.begin(), fixes.end(), [&id](const TrackerFix& fix) { return id == fix.id; });
}

QString verdict(const std::vector<TrackerFinding>& findings)
{
    const auto errors = std::count_if(findings.begin(), findings.end(),
                                      [](const TrackerFinding& f) { return f.level == FindingLevel::Error; });
    if (findings.empty())
        return frmTracker::tr("Nothing to fix: the Parts Tracker's rules find nothing.");
    return errors == 0 ? frmTracker::tr("The Parts Tracker would accept this file, with the warnings below.")
                       : frmTracker::tr("The Parts Tracker would refuse this file: %1 error(s) to fix.").arg(errors);
}

// Errors before warnings, then by id, then by line.
bool listedBefore(const TrackerFinding& a, const TrackerFinding& b)
{
    return std::tie(a.level, a.id, a.line) < std::tie(b.level, b.id, b.line);
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

frmTracker::frmTracker(const std::vector<TrackerFinding>& findings, const QString& filePath, QWidget* parent,
                       Repairer repair)
    : QDialog(parent), filePath_(filePath), repair_(std::move(repair))
{
    setObjectName("frmTracker");
    setWindowTitle(tr("Check for the Parts Tracker"));
    setModal(true);
    resize(Pixels(9240), Pixels(4200));
    lblVerdict = new QLabel(verdict(findings), this);
    lblVerdict->setObjectName("lblVerdict");
    lblVerdict->setWordWrap(true);
    tbFindings = new QTableWidget(this);
    tbFindings->setObjectName("tbFindings");
    cmdCopy = new QPushButton(tr("Copy"), this);
    cmdCopy->setObjectName("cmdCopy");
    cmdClose = new QPushButton(tr("Close"), this);
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
    fillTable(findings);
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
    const auto index = tbFindings->item(row, LevelColumn)->data(Qt::UserRole).toULongLong();
    const auto& finding = findings_[static_cast<std::size_t>(index)];
    if (finding.line == 0 && showField_ && showField_(finding))
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

void frmTracker::fillTable(std::vector<TrackerFinding> findings)
{
    std::stable_sort(findings.begin(), findings.end(), listedBefore);
    findings_ = findings;
    tbFindings->setSortingEnabled(false); // rows filled again stay where they are put
    tbFindings->setColumnCount(5);
    tbFindings->setHorizontalHeaderLabels({tr("Level"), tr("Id"), tr("Line"), tr("Fix"), tr("Message")});
    tbFindings->setRowCount(static_cast<int>(findings.size()));
    tbFindings->setEditTriggers(QAbstractItemView::NoEditTriggers);
    tbFindings->setSelectionBehavior(QAbstractItemView::SelectRows);
    tbFindings->setWordWrap(true);
    tbFindings->verticalHeader()->hide();
    tbFindings->verticalHeader()->setSectionResizeMode(QHeaderView::ResizeToContents);
    tbFindings->horizontalHeader()->setStretchLastSection(true);
    for (int row = 0; row < tbFindings->rowCount(); ++row) {
        const auto& finding = findings[static_cast<std::size_t>(row)];
        auto* level = new QTableWidgetItem(finding.level == FindingLevel::Error ? tr("error") : tr("warning"));
        level->setData(Qt::UserRole, row); // the row's finding, wherever sorting moves the row
        tbFindings->setItem(row, LevelColumn, level);
        tbFindings->setItem(row, IdColumn, new QTableWidgetItem(QString::fromStdString(finding.id)));
        tbFindings->setItem(row, LineColumn, new LineItem(finding.line));
        tbFindings->setItem(row, MessageColumn, new QTableWidgetItem(QString::fromStdString(finding.text)));
    }
    markFixableRows();
    // Sorting by level keeps the order within each level: errors first, then by id.
    tbFindings->horizontalHeader()->setSortIndicator(LevelColumn, Qt::AscendingOrder);
    tbFindings->setSortingEnabled(true);
    // Measured with the sort arrow in place, so that no column title is cut.
    for (const auto column : {LevelColumn, IdColumn, LineColumn, FixColumn})
        tbFindings->resizeColumnToContents(column);
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
    cmdFix = new QPushButton(tr("Fix"), this);
    cmdFix->setObjectName("cmdFix");
    cmdFixAll = new QPushButton(tr("Fix All"), this);
    cmdFixAll->setObjectName("cmdFixAll");
    buttons.addWidget(cmdFix);
    buttons.addWidget(cmdFixAll);
    connect(cmdFix, &QPushButton::clicked, this, &frmTracker::cmdFix_Click);
    connect(cmdFixAll, &QPushButton::clicked, this, &frmTracker::cmdFixAll_Click);
}

// "yes" in the Fix column of each finding that has a repair, when the dialog can repair.
void frmTracker::markFixableRows()
{
    for (int row = 0; row < tbFindings->rowCount(); ++row) {
        const bool fixable = repair_ && hasRepair(tbFindings->item(row, IdColumn)->text());
        tbFindings->setItem(row, FixColumn, new QTableWidgetItem(fixable ? tr("yes") : QString()));
    }
}

void frmTracker::cmdFix_Click()
{
    std::set<std::string> ids;
    for (const auto* item : tbFindings->selectedItems())
        if (item->column() == IdColumn && hasRepair(item->text()))
            ids.insert(item->text().toStdString());
    if (!ids.empty())
        showRepaired(ids);
}

void frmTracker::cmdFixAll_Click() { showRepaired(DefaultFixIds()); }

void frmTracker::showRepaired(const std::set<std::string>& ids)
{
    const auto findings = repair_(ids);
    lblVerdict->setText(verdict(findings));
    fillTable(findings);
}
