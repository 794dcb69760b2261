#pragma once

#include <QDialog>
#include <vector>

#include "TrackerCheck.h"

class QLabel;
class QPushButton;
class QTableWidget;

// Shows what the Parts Tracker's rules find in the header as it would be saved; changes nothing.
class frmTracker : public QDialog {
    Q_OBJECT

public:
    frmTracker(const std::vector<TrackerFinding>& findings, QWidget* parent = nullptr);

private:
    QLabel* lblVerdict;
    QTableWidget* tbFindings;
    QPushButton* cmdClose;
};
