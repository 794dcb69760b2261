// SPDX-License-Identifier: MIT
#include "TextCheck.h"

#include <sstream>

#include "ColourSource.h"
#include "Composer.h"
#include "ConsoleDialogs.h"
#include "FindingPlaces.h"
#include "OpenDocument.h"
#include "ParseProgress.h"

RecordCheck CheckRecord(const HeaderData& header, const CheckSetup& setup, Dialogs& dialogs)
{
    RecordCheck check{EvaluateSaveChecks(header, setup.limitDescription), ComposeHeader(header), {}};
    if (setup.categories != nullptr) {
        const auto& codes =
            setup.colours->forPart(header.FilePath, [&dialogs](const std::string& text) { dialogs.message({text}); });
        check.tracker = CheckRecordForTracker(header, check.composed, *setup.categories, codes);
    }
    return check;
}

bool HasFindings(const RecordCheck& check)
{
    const auto& save = check.save;
    return !check.tracker.empty() || !save.refusals.empty() || save.missingUserName || save.fixups.color;
}

std::vector<FileFinding> FindingsOfRecord(const HeaderData& header, const RecordCheck& check,
                                          std::string_view fileBytes, bool tracker)
{
    const FindingPlaces places(fileBytes, header, check.composed);
    auto findings = SaveCheckFindings(check.save, places);
    if (tracker) {
        const auto trackerFindings = TrackerFileFindings(check.tracker, places);
        findings.insert(findings.end(), trackerFindings.begin(), trackerFindings.end());
    }
    return findings;
}

namespace {

HeaderData openText(const std::string& bytes, const std::string& path)
{
    std::ostringstream unheard;
    ConsoleDialogs dialogs(unheard);
    HeaderData header;
    ParseProgress silent;
    OpenPartFileContent(header, path, bytes, dialogs, silent);
    return header;
}

} // namespace

FileRepairs RepairPartText(const std::string& bytes, const std::string& path, const std::set<std::string>& chosen,
                           const FixContext& context)
{
    auto header = openText(bytes, path);
    // The record as read, without the body, as fix hands it over.
    auto body = std::move(header.Body);
    const HeaderData read = header;
    header.Body = std::move(body);
    return RepairsOf(bytes, read, header, chosen, context);
}

std::vector<FileFinding> CheckPartText(const std::string& bytes, const std::string& path, const CheckSetup& setup)
{
    std::ostringstream unheard;
    ConsoleDialogs dialogs(unheard);
    HeaderData header;
    ParseProgress silent;
    // The record's body takes the bytes it reads; the places are found in the text as given.
    OpenPartFileContent(header, path, bytes, dialogs, silent);
    return FindingsOfRecord(header, CheckRecord(header, setup, dialogs), bytes, setup.categories != nullptr);
}
