// SPDX-License-Identifier: MIT
#include "TextCheck.h"

#include <algorithm>
#include <iterator>
#include <sstream>

#include "ColourSource.h"
#include "Composer.h"
#include "ConsoleDialogs.h"
#include "FileReport.h"
#include "FindingPlaces.h"
#include "OpenDocument.h"
#include "ParseProgress.h"

namespace {

// Takes the refusal of the check id out of findings; whether there was one.
bool takeRefusal(SaveFindings& findings, std::string_view id)
{
    const auto found = std::find(findings.refusalIds.begin(), findings.refusalIds.end(), id);
    if (found == findings.refusalIds.end())
        return false;
    findings.refusals.erase(findings.refusals.begin() + (found - findings.refusalIds.begin()));
    findings.refusalIds.erase(found);
    return true;
}

HeaderData openText(const std::string& bytes, const std::string& path, Dialogs& dialogs)
{
    HeaderData header;
    ParseProgress silent;
    OpenPartFileContent(header, path, bytes, dialogs, silent);
    return header;
}

} // namespace

void KeepReported(CheckedFile& file, const RuleChoice& choice)
{
    auto& save = file.save;
    for (std::size_t k = save.refusals.size(); k-- > 0;)
        if (!choice.reports(save.refusalIds[k])) {
            save.refusals.erase(save.refusals.begin() + static_cast<std::ptrdiff_t>(k));
            save.refusalIds.erase(save.refusalIds.begin() + static_cast<std::ptrdiff_t>(k));
        }
    save.missingUserName = save.missingUserName && choice.reports(SaveCheckIds::UserName);
    auto& fixups = save.fixups;
    const auto names = FixUpNames(fixups);
    bool* const offered[] = {&fixups.certifyInvertNext, &fixups.rotation, &fixups.write, &fixups.color};
    for (std::size_t k = 0; k < names.size(); ++k)
        *offered[k] = *offered[k] && choice.reports(names[k].id);
    file.lengthWarning = file.lengthWarning && choice.reports(SaveCheckIds::DescriptionLength);
    std::erase_if(file.tracker, [&choice](const TrackerFinding& finding) { return !choice.reports(finding.id); });
}

RecordCheck CheckRecord(const HeaderData& header, const PartSettings& settings, const TrackerLists& lists,
                        Dialogs& dialogs)
{
    RecordCheck check;
    check.file.save = EvaluateSaveChecks(header, settings.limitDescription);
    check.composed = ComposeHeader(header);
    auto& file = check.file;
    if (lists.categories != nullptr) {
        // The Tracker takes a long description: under its rules the length alone only warns.
        file.lengthWarning = takeRefusal(file.save, SaveCheckIds::DescriptionLength);
        const auto tell = [&dialogs](const std::string& text) { dialogs.message({text}); };
        const auto& codes = settings.ldconfig.empty() ? lists.colours->forPart(header.FilePath, tell)
                                                      : lists.colours->ofLDConfig(settings.ldconfig, tell);
        file.tracker = CheckRecordForTracker(header, check.composed, *lists.categories, codes);
        file.trackerChecked = true;
    }
    KeepReported(file, settings.choice);
    return check;
}

bool HasPlacedFindings(const CheckedFile& file)
{
    // The other fix-ups are about the whole body.
    const auto& save = file.save;
    return !save.refusals.empty() || save.missingUserName || save.fixups.color || file.lengthWarning ||
           !file.tracker.empty();
}

std::vector<FileFinding> PlacedFindings(const RecordCheck& check, const HeaderData& header, std::string_view fileBytes)
{
    const auto& file = check.file;
    const FindingPlaces places(fileBytes, header, check.composed);
    auto findings = SaveCheckFindings(file.save, places);
    if (file.lengthWarning)
        findings.push_back(DescriptionLengthWarning(header, places));
    auto tracker = TrackerFileFindings(file.tracker, places);
    findings.insert(findings.end(), std::make_move_iterator(tracker.begin()), std::make_move_iterator(tracker.end()));
    SortByPlace(findings);
    return findings;
}

FileRepairs RepairPartText(const std::string& bytes, const std::string& path, const std::set<std::string>& chosen,
                           const FixContext& context)
{
    std::ostringstream unheard;
    ConsoleDialogs dialogs(unheard);
    auto header = openText(bytes, path, dialogs);
    // The record as read, without the body, as fix hands it over.
    auto body = std::move(header.Body);
    const HeaderData read = header;
    header.Body = std::move(body);
    return RepairsOf(bytes, read, header, chosen, context);
}

std::vector<FileFinding> CheckPartText(const std::string& bytes, const std::string& path, const PartSettings& settings,
                                       const TrackerLists& lists)
{
    std::ostringstream unheard;
    ConsoleDialogs dialogs(unheard);
    // The record's body takes the bytes it reads; the places are found in the text as given.
    const auto header = openText(bytes, path, dialogs);
    return PlacedFindings(CheckRecord(header, settings, lists, dialogs), header, bytes);
}
