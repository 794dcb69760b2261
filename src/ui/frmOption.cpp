#include "frmOption.h"

#include <QCheckBox>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

#include "TwipLayout.h"

frmOption::frmOption(const PreferencesForm& form, const QStringList& sortedLicenses, QWidget* parent)
    : QDialog(parent)
{
    setObjectName("frmOption");
    setWindowTitle("Preferences");
    setModal(true);
    setFixedSize(Pixels(7455), Pixels(1890));
    Label1 = PlaceChild<QLabel>(this, "Label1", 120, 240, 1215, 255);
    Label1->setText("Your Real Name");
    txRealName = PlaceChild<QLineEdit>(this, "txRealName", 1560, 240, 4455, 285);
    Label2_0 = PlaceChild<QLabel>(this, "Label2_0", 120, 600, 1215, 255);
    Label2_0->setText("Your Username");
    txUserName = PlaceChild<QLineEdit>(this, "txUserName", 1560, 600, 4455, 285);
    cmdSave = PlaceChild<QPushButton>(this, "cmdSave", 6240, 240, 1095, 375);
    cmdSave->setText("&Save");
    cmdSave->setDefault(true);
    cmdCancel = PlaceChild<QPushButton>(this, "cmdCancel", 6240, 720, 1095, 375);
    cmdCancel->setText("&Cancel");
    cbLicenses = PlaceChild<QComboBox>(this, "cbLicenses", 1560, 960, 4455, 315);
    Label2_3 = PlaceChild<QLabel>(this, "Label2_3", 120, 960, 1335, 255);
    Label2_3->setText("Liscense Type:");
    chkBackup = PlaceChild<QCheckBox>(this, "chkBackup", 120, 1440, 1695, 255);
    chkBackup->setText("Backup file");
    QWidget::setTabOrder(txRealName, txUserName);
    QWidget::setTabOrder(txUserName, cmdSave);
    QWidget::setTabOrder(cmdSave, cmdCancel);
    QWidget::setTabOrder(cmdCancel, cbLicenses);
    QWidget::setTabOrder(cbLicenses, chkBackup);

    txRealName->setText(QString::fromStdString(form.realName));
    txUserName->setText(QString::fromStdString(form.userName));
    cbLicenses->addItems(sortedLicenses);
    cbLicenses->setCurrentIndex(-1);
    const auto stored = QString::fromStdString(form.license);
    for (int i = 0; i < cbLicenses->count(); ++i)
        if (!form.license.empty() && cbLicenses->itemText(i) == stored)
            cbLicenses->setCurrentIndex(i); // the last equal entry stays selected
    chkBackup->setChecked(form.backup);
    connect(cmdSave, &QPushButton::clicked, this, &QDialog::accept);
    connect(cmdCancel, &QPushButton::clicked, this, &QDialog::reject);
}

PreferencesForm frmOption::form() const
{
    return {txRealName->text().toStdString(), txUserName->text().toStdString(),
            cbLicenses->currentIndex() < 0 ? std::string() : cbLicenses->currentText().toStdString(),
            chkBackup->isChecked()};
}
