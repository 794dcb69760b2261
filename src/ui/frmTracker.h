// SPDX-License-Identifier: MIT
#pragma once

#include <QDialog>
#include <functional>
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

    // A double-click on a finding about the whole file hands it to showField; the dialog closes
    // when showField found where to lead the user.
    void leadToFields(std::function<bool(const TrackerFinding&)> showField);

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void fillTable(std::vector<TrackerFinding> findings);
    QString rowsText(const QList<int>& rows) const;
    // Ctrl+C in the table: the selected rows, worded as Copy words them.
    void copySelectedRows() const;
    void findingDoubleClicked(int row);

    std::vector<TrackerFinding> findings_; // in the order of filling; each row keeps its index
    std::function<bool(const TrackerFinding&)> showField_;
    QString filePath_;
    QLabel* lblVerdict;
    QTableWidget* tbFindings;
    QPushButton* cmdCopy;
    QPushButton* cmdClose;
};
