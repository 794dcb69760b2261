// SPDX-License-Identifier: MIT
#pragma once

#include <QDialog>

#include "ListEditor.h"

class QGroupBox;
class QLineEdit;
class QListWidget;
class QPushButton;

// The dialog that edits one standard list: the rules are the ListEditor's, this only shows them.
class frmList : public QDialog {
    Q_OBJECT

public:
    frmList(ListKind kind, const StringList& entries, const std::string& programFolder, Dialogs& dialogs,
            QWidget* parent = nullptr);

protected:
    void keyPressEvent(QKeyEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;

private:
    void showEntries();
    void cmdClose_Click();

    ListEditor editor_;
    QGroupBox* Frame1;
    QListWidget* lsValues;
    QPushButton* cmdChange;
    QPushButton* cmdAdd;
    QPushButton* cmdClose;
    QLineEdit* txUpdate;
    QPushButton* cmdDelete;
};
