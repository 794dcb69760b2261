#include "frmTracker.h"

#include <QHeaderView>
#include <QLabel>
#include <QPushButton>
#include <QTableWidget>
#include <algorithm>

#include "TwipLayout.h"

namespace {

QString verdict(const std::vector<TrackerFinding>& findings)
{
    const auto errors = std::count_if(findings.begin(), findings.end(),
                                      [](const TrackerFinding& f) { return f.level == FindingLevel::Error; });
    if (findings.empty())
        return "Nothing to fix: the Parts Tracker's header rules find nothing.";
    return errors == 0 ? "The Parts Tracker would accept this file, with the warnings below."
                       : QString("The Parts Tracker would refuse this file: %1 error(s) to fix.").arg(errors);
}

} // namespace

frmTracker::frmTracker(const std::vector<TrackerFinding>& findings, QWidget* parent) : QDialog(parent)
{
    setObjectName("frmTracker");
    setWindowTitle("Check for the Parts Tracker");
    setModal(true);
    setFixedSize(Pixels(9240), Pixels(4200));
    lblVerdict = PlaceCaptioned<QLabel>(this, "lblVerdict", "", 120, 120, 9000, 255);
    lblVerdict->setText(verdict(findings));
    tbFindings = PlaceChild<QTableWidget>(this, "tbFindings", 120, 480, 9000, 3000);
    tbFindings->setColumnCount(3);
    tbFindings->setHorizontalHeaderLabels({"Level", "Id", "Message"});
    tbFindings->setRowCount(static_cast<int>(findings.size()));
    tbFindings->setEditTriggers(QAbstractItemView::NoEditTriggers);
    tbFindings->verticalHeader()->hide();
    tbFindings->horizontalHeader()->setStretchLastSection(true);
    for (int row = 0; row < tbFindings->rowCount(); ++row) {
        const auto& finding = findings[static_cast<std::size_t>(row)];
        tbFindings->setItem(row, 0, new QTableWidgetItem(LevelText(finding.level)));
        tbFindings->setItem(row, 1, new QTableWidgetItem(QString::fromStdString(finding.id)));
        tbFindings->setItem(row, 2, new QTableWidgetItem(QString::fromStdString(finding.text)));
    }
    tbFindings->resizeColumnToContents(0);
    tbFindings->resizeColumnToContents(1);
    cmdClose = PlaceCaptioned<QPushButton>(this, "cmdClose", "Close", 7800, 3720, 1320, 375);
    cmdClose->setDefault(true);
    connect(cmdClose, &QPushButton::clicked, this, &QDialog::accept);
}
