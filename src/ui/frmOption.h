// SPDX-License-Identifier: MIT
#pragma once

#include <QDialog>

#include "Preferences.h"

class QCheckBox;
class QComboBox;
class QLabel;
class QLineEdit;
class QPushButton;

// The check box that limits the description, named where a refusal tells how to lift the limit.
inline constexpr const char* DescriptionLimitCaption =
    QT_TRANSLATE_NOOP("frmOption", "Limit Part Description to 64 characters");

// The preferences window: the author's names, default licence, backup and description-limit choices.
class frmOption : public QDialog {
    Q_OBJECT

public:
    frmOption(const PreferencesForm& form, const QStringList& sortedLicenses, QWidget* parent = nullptr);

    // What the window holds now, for saving.
    PreferencesForm form() const;

    // One line more, under the others: what the names are used for.
    void explainNames();

private:
    QLabel* Label1;
    QLineEdit* txRealName;
    QLabel* Label2_0;
    QLineEdit* txUserName;
    QPushButton* cmdSave;
    QPushButton* cmdCancel;
    QComboBox* cbLicenses;
    QLabel* Label2_3;
    QCheckBox* chkBackup;
    QCheckBox* chkDescriptionLimit;
};
