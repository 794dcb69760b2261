// SPDX-License-Identifier: MIT
#include "TextCheck.h"

#include <sstream>

#include "ColourSource.h"
#include "Composer.h"
#include "ConsoleDialogs.h"
#include "FileLinePlaces.h"
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

std::vector<FileFinding> FindingsOfRecord(const HeaderData& header, const RecordCheck& check, bool tracker)
{
    const FileLinePlaces places(header, check.composed);
    auto findings = SaveCheckFindings(check.save, places);
    if (tracker) {
        const auto trackerFindings = TrackerFileFindings(check.tracker, places);
        findings.insert(findings.end(), trackerFindings.begin(), trackerFindings.end());
    }
    return findings;
}

std::vector<FileFinding> CheckPartText(std::string bytes, const std::string& path, const CheckSetup& setup)
{
    std::ostringstream unheard;
    ConsoleDialogs dialogs(unheard);
    HeaderData header;
    ParseProgress silent;
    OpenPartFileContent(header, path, std::move(bytes), dialogs, silent);
    return FindingsOfRecord(header, CheckRecord(header, setup, dialogs), setup.categories != nullptr);
}
