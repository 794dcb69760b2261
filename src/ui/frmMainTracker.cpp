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
#include "frmMain.h"
#include "frmTracker.h"

namespace {

// "1 error", "2 errors": one form for one thing, the other for any other number.
QString counted(long long count, const QString& one, const QString& many)
{
    return (count == 1 ? one : many).arg(count);
}

} // namespace

std::vector<TrackerFinding> frmMain::trackerFindings(const std::function<void(const std::string&)>& report)
{
    const auto builtIn = ReadBuiltInColours(DataFileOfThisProgram(app_.ProgramFolder, BuiltInColoursFile));
    ColourSource colours(builtIn, "", report);
    return CheckRecordForTracker(app_.Header, newHeaderText_, EntriesOf(app_.Lists, ListKind::Category),
                                 colours.forPart(app_.Header.FilePath, report));
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
        const auto findings = CheckRecordForTracker(app_.Header, newHeaderText_, categories, codes);
        const auto repair = [&](const std::set<std::string>& ids) { return fixForTracker(ids, categories, codes); };
        frmTracker dialog(findings, QString::fromStdString(app_.Header.FilePath), this, repair);
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
    const std::pair<const char*, QWidget*> byId[] = {{"description.", txPartDescription},
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

// "Parts Tracker: 2 errors, 1 warning (Ctrl+T)", or "Parts Tracker: no findings". Colour lists
// that cannot be read are told about by the dialog, not after every save.
QString frmMain::trackerSummary()
{
    std::vector<TrackerFinding> findings;
    try {
        findings = trackerFindings([](const std::string&) {});
    } catch (const std::exception&) { // the file is saved all the same; the dialog tells what failed
        return tr("Parts Tracker: not checked (%1)").arg(MTrackerCheck->shortcut().toString());
    }
    if (findings.empty())
        return tr("Parts Tracker: no findings");
    const auto errors = std::count_if(findings.begin(), findings.end(),
                                      [](const TrackerFinding& f) { return f.level == FindingLevel::Error; });
    const auto warnings = static_cast<long long>(findings.size()) - errors;
    QStringList counts;
    if (errors > 0)
        counts << counted(errors, tr("%1 error"), tr("%1 errors"));
    if (warnings > 0)
        counts << counted(warnings, tr("%1 warning"), tr("%1 warnings"));
    return tr("Parts Tracker: %1 (%2)").arg(counts.join(", "), MTrackerCheck->shortcut().toString());
}
