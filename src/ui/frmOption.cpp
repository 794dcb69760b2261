// SPDX-License-Identifier: MIT
#include "frmOption.h"

#include <QCheckBox>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

#include "TwipLayout.h"

frmOption::frmOption(const PreferencesForm& form, const QStringList& sortedLicenses, QWidget* parent) : QDialog(parent)
{
    setObjectName("frmOption");
    setWindowTitle(tr("Preferences"));
    setModal(true);
    const double scale = LayoutScale(font());
    setFixedSize(Pixels(7455, scale), Pixels(2250, scale));
    using Row = ControlRow<frmOption, QLabel, QLineEdit, QPushButton, QComboBox, QCheckBox>;
    static const Row rows[] = {
        {&frmOption::Label1, "Label1", QT_TR_NOOP("Your Real Name"), 120, 240, 1215, 255},
        {&frmOption::txRealName, "txRealName", nullptr, 1560, 240, 4455, 285},
        {&frmOption::Label2_0, "Label2_0", QT_TR_NOOP("Your Username"), 120, 600, 1215, 255},
        {&frmOption::txUserName, "txUserName", nullptr, 1560, 600, 4455, 285},
        {&frmOption::cmdSave, "cmdSave", QT_TR_NOOP("&Save"), 6240, 240, 1095, 375},
        {&frmOption::cmdCancel, "cmdCancel", QT_TR_NOOP("&Cancel"), 6240, 720, 1095, 375},
        {&frmOption::cbLicenses, "cbLicenses", nullptr, 1560, 960, 4455, 315},
        {&frmOption::Label2_3, "Label2_3", QT_TR_NOOP("License Type:"), 120, 960, 1335, 255},
        {&frmOption::chkBackup, "chkBackup", QT_TR_NOOP("Backup file"), 120, 1440, 1695, 255},
        {&frmOption::chkDescriptionLimit, "chkDescriptionLimit", DescriptionLimitCaption, 120, 1800, 4455, 255},
    };
    BuildControls(*this, this, rows);
    cmdSave->setDefault(true);
    ChainTabOrder({txRealName, txUserName, cmdSave, cmdCancel, cbLicenses, chkBackup, chkDescriptionLimit});

    txRealName->setText(QString::fromStdString(form.realName));
    txUserName->setText(QString::fromStdString(form.userName));
    cbLicenses->addItems(sortedLicenses);
    cbLicenses->setCurrentIndex(-1);
    const auto stored = QString::fromStdString(form.license);
    for (int i = 0; i < cbLicenses->count(); ++i)
        if (!form.license.empty() && cbLicenses->itemText(i) == stored)
            cbLicenses->setCurrentIndex(i); // the last equal entry stays selected
    chkBackup->setChecked(form.backup);
    chkDescriptionLimit->setChecked(form.descriptionLimit);
    connect(cmdSave, &QPushButton::clicked, this, &QDialog::accept);
    connect(cmdCancel, &QPushButton::clicked, this, &QDialog::reject);
}

PreferencesForm frmOption::form() const
{
    return {txRealName->text().toStdString(), txUserName->text().toStdString(),
            cbLicenses->currentIndex() < 0 ? std::string() : cbLicenses->currentText().toStdString(),
            chkBackup->isChecked(), chkDescriptionLimit->isChecked()};
}

void frmOption::explainNames()
{
    const double scale = LayoutScale(font());
    PlaceCaptioned<QLabel>(this, "lblNamesUse",
                           tr("Your names go into the Author line of the parts you save and into new History lines."),
                           120, 2160, 7215, 255, scale);
    setFixedSize(width(), Pixels(2520, scale));
}
