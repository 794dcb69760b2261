// SPDX-License-Identifier: MIT
#pragma once

#include <QDialog>
#include <functional>
#include <set>
#include <string>
#include <vector>

#include "SaveStops.h"

class QHBoxLayout;
class QLabel;
class QPushButton;
class QTableWidget;

// Shows what stops a save and what the Parts Tracker's rules find in the file as it would be saved,
// in one table. The table grows with the dialog, lists errors first, sorts by any column, and
// copies as text. Given a repairer, it marks the rows whose repair can be made and repairs the
// selected rows ("Fix") or every row repaired by default ("Fix All"), then shows the rows
// afterwards.
class frmTracker : public QDialog {
    Q_OBJECT

public:
    // Repairs the findings of the ids given in the open document; returns the rows afterwards.
    using Repairer = std::function<std::vector<StopRow>(const std::set<std::string>& ids)>;

    frmTracker(const std::vector<StopRow>& rows, const QString& filePath, QWidget* parent = nullptr,
               Repairer repair = {});

    // The file's path, then one line per finding in the table's order: level, id, message.
    QString findingsText() const;

    // A double-click on a row hands its finding to showField; the dialog closes
    // when showField found where to lead the user.
    void leadToFields(std::function<bool(const TrackerFinding&)> showField);

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void fillTable(std::vector<StopRow> rows);
    void addFixButtons(QHBoxLayout& buttons);
    void cmdFix_Click();
    void cmdFixAll_Click();
    void showRepaired(const std::set<std::string>& ids);
    const StopRow& rowAt(int tableRow) const;
    QString rowsText(const QList<int>& rows) const;
    // Ctrl+C in the table: the selected rows, worded as Copy words them.
    void copySelectedRows() const;
    void findingDoubleClicked(int row);

    std::vector<StopRow> rows_; // in the order of filling; each table row keeps its index
    std::function<bool(const TrackerFinding&)> showField_;
    QString filePath_;
    QLabel* lblVerdict;
    QTableWidget* tbFindings;
    QPushButton* cmdCopy;
    QPushButton* cmdClose;
    Repairer repair_;
    QPushButton* cmdFix = nullptr;
    QPushButton* cmdFixAll = nullptr;
};
