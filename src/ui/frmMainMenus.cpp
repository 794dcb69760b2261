// The Edit menu's list dialogs, the preferences, and applying them to the open file.
#include <QComboBox>
#include <QLineEdit>

#include "Dialogs.h"
#include "ErrorReport.h"
#include "FileText.h"
#include "frmList.h"
#include "frmMain.h"
#include "frmOption.h"
#include "frmTracker.h"

namespace {

QStringList displayTexts(const StringList& entries)
{
    QStringList texts;
    for (const auto& entry : SortedForDisplay(entries))
        texts << ListEntryToWidget(entry);
    return texts;
}

} // namespace

void frmMain::MEditCategory_Click() { editStandardList(ListKind::Category, *cbCategory, "MEditCategory_Click"); }
void frmMain::MEditPartTyps_Click() { editStandardList(ListKind::PartType, *cbPartTypes, "MEditPartTyps_Click"); }
void frmMain::MEditBFCStatement_Click()
{
    editStandardList(ListKind::Bfc, *cbBFCStatement, "MEditBFCStatement_Click");
}
void frmMain::MEditLicense_Click() { editStandardList(ListKind::License, *cbLicenses, "MEditLicense_Click"); }

void frmMain::editStandardList(ListKind kind, QComboBox& combo, const char* handler)
{
    if (openInProgress())
        return;
    if (kind == ListKind::Category) {
        const auto answer = services_.dialogs.message(
            {"To change the category can result in an non LDraw conform part. Please change the category only if "
             "there is an official statement from LSC.\r\nDo you want to proceed?",
             "Category Change", Buttons::YesNo, Icon::Exclamation, Answer::No});
        if (answer != Answer::Yes)
            return;
    }
    try {
        frmList dialog(kind, EntriesOf(app_.Lists, kind), app_.ProgramFolder, services_.dialogs, this);
        dialog.exec();
        // The program only ever sees what was saved: the list is read again from its file.
        ReloadList(app_.Lists, kind, app_.ProgramFolder, services_.dialogs);
        fillCombo(combo, kind);
    } catch (const std::exception& error) {
        ReportError(services_.dialogs, ErrorOf(error), {handler, OwnerKind::Formular, "frmMain"});
    }
}

void frmMain::MTrackerCheck_Click()
{
    if (openInProgress())
        return;
    const auto findings = CheckRecordForTracker(app_.Header, newHeaderText_, EntriesOf(app_.Lists, ListKind::Category));
    frmTracker dialog(findings, this);
    dialog.exec();
}

void frmMain::MEinstellDefault_Click()
{
    if (openInProgress())
        return;
    const auto form = OpenPreferencesForm(app_.Prefs, services_.store);
    frmOption dialog(form, displayTexts(app_.Lists.Licenses), this);
    if (dialog.exec() == QDialog::Accepted)
        SavePreferencesForm(dialog.form(), app_.Prefs, services_.store);
    showLength(); // the limit may have changed
}

void frmMain::cmdSetPreferences_Click()
{
    const auto answer = services_.dialogs.message(QuestionBox(
        "Are you sure to subsitute the existing Real Name, Username and License Type with your values set in the "
        "preferences?",
        "Default Values"));
    if (answer != Answer::Yes)
        return;
    LadeDefaults(app_.Prefs, services_.store);
    const std::pair<QLineEdit*, std::string*> names[] = {{txAuthorRealName, &app_.Prefs.DefaultRealName},
                                                         {txAuthorUserName, &app_.Prefs.DefaultUserName}};
    for (const auto& [box, value] : names)
        box->setText(QString::fromStdString(*value));
    updateTextField(*txAuthorRealName, app_.Header.AuthorRealName);
    updateTextField(*txAuthorUserName, app_.Header.AuthorUserName);
    const auto license = QString::fromStdString(app_.Prefs.DefaultLicense);
    for (int i = 0; i < cbLicenses->count(); ++i) {
        if (cbLicenses->itemText(i) != license)
            continue;
        if (cbLicenses->currentIndex() == i)
            updateComboField(*cbLicenses, app_.Header.License); // chosen again: the same as a new choice
        else
            cbLicenses->setCurrentIndex(i);
        break;
    }
    MakeNewHeader();
}
