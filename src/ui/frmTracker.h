// SPDX-License-Identifier: MIT
#pragma once

#include <QDialog>
#include <functional>
#include <set>
#include <string>
#include <vector>

#include "TrackerCheck.h"

class QHBoxLayout;
class QLabel;
class QPushButton;
class QTableWidget;

// Shows what the Parts Tracker's rules find in the file as it would be saved. The table grows with
// the dialog, lists errors first, sorts by any column, and copies as text. Given a repairer, it
// marks the rows that have a repair and repairs the selected rows ("Fix") or every finding
// repaired by default ("Fix All"), then shows what the rules find afterwards.
class frmTracker : public QDialog {
    Q_OBJECT

public:
    // Repairs the findings of the ids given in the open document; returns the findings afterwards.
    using Repairer = std::function<std::vector<TrackerFinding>(const std::set<std::string>& ids)>;

    frmTracker(const std::vector<TrackerFinding>& findings, const QString& filePath, QWidget* parent = nullptr,
               Repairer repair = {});

    // The file's path, then one line per finding in the table's order: level, id, message.
    QString findingsText() const;

private:
    void fillTable(std::vector<TrackerFinding> findings);
    void addFixButtons(QHBoxLayout& buttons);
    void markFixableRows();
    void cmdFix_Click();
    void cmdFixAll_Click();
    void showRepaired(const std::set<std::string>& ids);

    QString filePath_;
    QLabel* lblVerdict;
    QTableWidget* tbFindings;
    QPushButton* cmdCopy;
    QPushButton* cmdClose;
    Repairer repair_;
    QPushButton* cmdFix = nullptr;
    QPushButton* cmdFixAll = nullptr;
};
