// SPDX-License-Identifier: MIT
// The Edit menu's list dialogs, the preferences, and applying them to the open file.
#include <QComboBox>
#include <QLineEdit>

#include "Dialogs.h"
#include "DocumentQuestions.h"
#include "ErrorReport.h"
#include "FileText.h"
#include "ListFolder.h"
#include "frmHelp.h"
#include "frmList.h"
#include "frmMain.h"
#include "frmOption.h"

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
void frmMain::MEditBFCStatement_Click() { editStandardList(ListKind::Bfc, *cbBFCStatement, "MEditBFCStatement_Click"); }
void frmMain::MEditLicense_Click() { editStandardList(ListKind::License, *cbLicenses, "MEditLicense_Click"); }

void frmMain::editStandardList(ListKind kind, QComboBox& combo, const char* handler)
{
    if (openInProgress() || !MayEditList(kind, services_.dialogs))
        return;
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

void frmMain::MEinstellDefault_Click()
{
    if (!openInProgress())
        showPreferences(false);
}

void frmMain::OfferPreferencesWithoutNames()
{
    if (PreferencesHoldNoName(services_.store))
        showPreferences(true);
}

void frmMain::showPreferences(bool explainNames)
{
    const auto form = OpenPreferencesForm(app_.Prefs, services_.store);
    frmOption dialog(form, displayTexts(app_.Lists.Licenses), this);
    if (explainNames)
        dialog.explainNames();
    if (dialog.exec() == QDialog::Accepted)
        SavePreferencesForm(dialog.form(), app_.Prefs, services_.store);
    showLength(); // the limit may have changed
}

void frmMain::cmdSetPreferences_Click()
{
    if (!TakePreferencesIntoRecord(app_, services_, [this](const std::string& utf8) { return toFile(utf8); }))
        return;
    const auto encoding = app_.Header.Encoding;
    txAuthorRealName->setText(ToWidget(app_.Header.AuthorRealName, encoding));
    txAuthorUserName->setText(ToWidget(app_.Header.AuthorUserName, encoding));
    SelectComboItem(*cbLicenses, app_.Header.License);
    MakeNewHeader();
}

void frmMain::MHilfeInhalt_Click()
{
    frmHelp help(this);
    help.exec();
}
