// SPDX-License-Identifier: MIT
#pragma once

#include <QDialog>
#include <vector>

#include "TrackerCheck.h"

class QLabel;
class QPushButton;
class QTableWidget;

// Shows what the Parts Tracker's rules find in the file as it would be saved; changes nothing.
// The table grows with the dialog, lists errors first, sorts by any column, and copies as text.
class frmTracker : public QDialog {
    Q_OBJECT

public:
    frmTracker(const std::vector<TrackerFinding>& findings, const QString& filePath, QWidget* parent = nullptr);

    // The file's path, then one line per finding in the table's order: level, id, message.
    QString findingsText() const;

private:
    void fillTable(std::vector<TrackerFinding> findings);

    QString filePath_;
    QLabel* lblVerdict;
    QTableWidget* tbFindings;
    QPushButton* cmdCopy;
    QPushButton* cmdClose;
};
