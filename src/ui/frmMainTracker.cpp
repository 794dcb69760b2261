// SPDX-License-Identifier: MIT
// What the Parts Tracker would say about the file as it would be saved: its dialog, the way from
// a finding to the field it is about, and the word after each save.
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <algorithm>
#include <set>

#include "ColourSource.h"
#include "Dialogs.h"
#include "ErrorReport.h"
#include "ListFolder.h"
#include "SaveChecks.h"
#include "frmMain.h"
#include "frmOption.h"
#include "frmTracker.h"

namespace {

QString counted(long long count, const QString& one, const QString& many) { return count == 1 ? one : many.arg(count); }

} // namespace

std::vector<StopRow> frmMain::stopRows(const StringList& categories, const ColourCodes& colours)
{
    const StopContext context{categories, colours, app_.Prefs.LimitDescription,
                              tr("%1 in Option › Preferences").arg(tr(DescriptionLimitCaption)).toStdString(),
                              services_.clock.now()};
    return WhatStopsTheSave(app_.Header, newHeaderText_, context);
}

std::vector<StopRow> frmMain::stopRows(const std::function<void(const std::string&)>& report)
{
    const auto builtIn = ReadBuiltInColours(DataFileOfThisProgram(app_.ProgramFolder, BuiltInColoursFile));
    ColourSource colours(builtIn, "", report);
    return stopRows(EntriesOf(app_.Lists, ListKind::Category), colours.forPart(app_.Header.FilePath, report));
}

void frmMain::MTrackerCheck_Click()
{
    if (openInProgress())
        return;
    try {
        const auto report = [this](const std::string& text) {
            services_.dialogs.message({text, ProgramTitle, Buttons::Ok, Icon::Exclamation, Answer::Ok});
        };
        const auto builtIn = ReadBuiltInColours(DataFileOfThisProgram(app_.ProgramFolder, BuiltInColoursFile));
        ColourSource colours(builtIn, "", report);
        const auto& codes = colours.forPart(app_.Header.FilePath, report);
        const auto categories = EntriesOf(app_.Lists, ListKind::Category);
        const auto repair = [&](const std::set<std::string>& ids) { return fixForTracker(ids, categories, codes); };
        frmTracker dialog(stopRows(categories, codes), QString::fromStdString(app_.Header.FilePath), this, repair);
        dialog.leadToFields([this](const TrackerFinding& finding) { return focusFieldOf(finding); });
        dialog.exec();
    } catch (const std::exception& error) {
        ReportError(services_.dialogs, ErrorOf(error), {"MTrackerCheck_Click", OwnerKind::Formular, "frmMain"});
    }
}

// The control that edits what a finding about the whole file is about; nullptr for findings that
// no field of the window can mend.
QWidget* frmMain::fieldOf(const TrackerFinding& finding) const
{
    const std::pair<const char*, QWidget*> byId[] = {{SaveCheckIds::DescriptionLength, txPartDescription},
                                                     {SaveCheckIds::Author, txAuthorRealName},
                                                     {SaveCheckIds::UserName, txAuthorUserName},
                                                     {SaveCheckIds::Bfc, cbBFCStatement},
                                                     {SaveCheckIds::License, cbLicenses},
                                                     {SaveCheckIds::PartType, cbPartTypes},
                                                     {SaveCheckIds::NeedsWork, lsComments},
                                                     {"description.", txPartDescription},
                                                     {"warning.description", txPartDescription},
                                                     {"obsoleteimproper", txPartDescription},
                                                     {"name.", txFileName},
                                                     {"type.", cbPartTypes},
                                                     {"license.", cbLicenses},
                                                     {"bfc", cbBFCStatement},
                                                     {"category.", cbCategory},
                                                     {"warning.minifigcategory", cbCategory},
                                                     {"keywords.", lsKeyWords},
                                                     {"history.", lsHistory}};
    for (const auto& [prefix, field] : byId)
        if (finding.id.starts_with(prefix))
            return field;
    // One id stands for every missing line; its message names the line.
    const std::pair<const char*, QWidget*> missing[] = {{"description", txPartDescription},
                                                        {"Author:", txAuthorRealName},
                                                        {"!LDRAW_ORG", cbPartTypes},
                                                        {"!LICENSE", cbLicenses},
                                                        {"Name:", txFileName}};
    if (finding.id == "missing")
        for (const auto& [named, field] : missing)
            if (finding.text.find(named) != std::string::npos)
                return field;
    return nullptr;
}

bool frmMain::focusFieldOf(const TrackerFinding& finding)
{
    QWidget* field = fieldOf(finding);
    if (field == nullptr || !field->isEnabled()) // the file name is mended on disk, not here
        return false;
    field->setFocus(Qt::OtherFocusReason);
    return true;
}

// "Checks: 2 errors, 1 warning (Ctrl+T)", counting the save checks' rows and the Parts Tracker's
// findings, or "Checks: nothing found". Colour lists that cannot be read are told about by the
// dialog, not after every save.
QString frmMain::trackerSummary()
{
    std::vector<StopRow> rows;
    const auto keys = MTrackerCheck->shortcut().toString(QKeySequence::NativeText);
    try {
        rows = stopRows([](const std::string&) {});
    } catch (const std::exception&) { // the file is saved all the same; the dialog tells what failed
        return tr("Checks: not made (%1)").arg(keys);
    }
    if (rows.empty())
        return tr("Checks: nothing found");
    const auto errors = std::count_if(rows.begin(), rows.end(),
                                      [](const StopRow& row) { return row.finding.level == FindingLevel::Error; });
    const auto warnings = static_cast<long long>(rows.size()) - errors;
    QStringList counts;
    if (errors > 0)
        counts << counted(errors, tr("1 error"), tr("%1 errors"));
    if (warnings > 0)
        counts << counted(warnings, tr("1 warning"), tr("%1 warnings"));
    return tr("Checks: %1 (%2)").arg(counts.join(", "), keys);
}
