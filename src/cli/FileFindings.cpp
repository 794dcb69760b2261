// SPDX-License-Identifier: MIT
#include "FileFindings.h"

#include <algorithm>

#include "FileReport.h"
#include "Text.h"

namespace {

// The header line each save check is about.
const char* keywordOfSaveCheck(std::string_view id)
{
    if (id == SaveCheckIds::Author || id == SaveCheckIds::UserName)
        return "Author:";
    if (id == SaveCheckIds::Bfc)
        return "BFC";
    if (id == SaveCheckIds::License)
        return "!LICENSE";
    if (id == SaveCheckIds::PartType)
        return "!LDRAW_ORG";
    return ""; // the description's line
}

std::string firstLine(const std::string& text) { return text.substr(0, text.find('\r')); }

Severity severityOf(FindingLevel level) { return level == FindingLevel::Error ? Severity::Error : Severity::Warning; }

} // namespace

const char* SeverityText(Severity severity)
{
    switch (severity) {
    case Severity::Error: return "error";
    case Severity::Warning: return "warning";
    case Severity::Note: break;
    }
    return "note";
}

std::vector<FileFinding> SaveCheckFindings(const SaveFindings& save, const FindingPlaces& places)
{
    std::vector<FileFinding> findings;
    for (std::size_t k = 0; k < save.refusals.size(); ++k)
        findings.push_back({save.refusalIds[k], Severity::Error, firstLine(save.refusals[k]),
                            places.ofHeaderKeyword(keywordOfSaveCheck(save.refusalIds[k]))});
    if (save.missingUserName)
        findings.push_back({SaveCheckIds::UserName, Severity::Warning, "The author line names no user.",
                            places.ofHeaderKeyword("Author:")});
    for (const auto& [offered, what, id] : FixUpNames(save.fixups))
        if (offered)
            findings.push_back(
                {id, Severity::Note, std::string("A save would offer a fix-up: ") + what + ".",
                 std::string_view(id) == "save.fixup.color" ? places.ofHeaderKeyword("COLOR") : FindingPlace{}});
    return findings;
}

void SortByPlace(std::vector<FileFinding>& findings)
{
    const auto place = [](const FileFinding& finding) { return std::pair(finding.place.line, finding.place.column); };
    std::stable_sort(findings.begin(), findings.end(),
                     [&place](const FileFinding& a, const FileFinding& b) { return place(a) < place(b); });
}

FileFinding DescriptionLengthWarning(const HeaderData& header, const FindingPlaces& places)
{
    return {SaveCheckIds::DescriptionLength, Severity::Warning,
            "The description has " + std::to_string(CharacterCount(header.PartDescription, header.Encoding)) +
                " characters, more than " + std::to_string(DescriptionLimit) +
                "; older tools may cut it, the Parts Tracker takes it.",
            places.ofHeaderKeyword("")};
}

std::vector<FileFinding> TrackerFileFindings(const std::vector<TrackerFinding>& tracker, const FindingPlaces& places)
{
    std::vector<FileFinding> findings;
    for (const auto& finding : tracker)
        findings.push_back({finding.id, severityOf(finding.level), finding.text, places.of(finding)});
    return findings;
}
