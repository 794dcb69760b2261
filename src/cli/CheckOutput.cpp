// SPDX-License-Identifier: MIT
#include "CheckOutput.h"

#include <algorithm>

#include "FieldsJson.h"
#include "FileReport.h"
#include "PartFile.h"
#include "SarifLog.h"

namespace {

// The findings one by one into the JSON text of the file, without a tree of them all.
std::string jsonText(const HeaderData& header, const CheckedFile& file, const std::vector<FileFinding>& findings)
{
    auto text = CheckJson(header, file.save).dump();
    const auto list = [&](const char* key, auto&& belongs) {
        text.pop_back(); // the closing brace, written again after the list
        text.append(",\"").append(key).append("\":[");
        bool first = true;
        for (const auto& finding : findings) {
            if (!belongs(finding))
                continue;
            nlohmann::ordered_json entry{
                {"id", finding.id}, {"level", SeverityText(finding.severity)}, {"text", finding.message}};
            if (!finding.place.wholeFile) {
                entry["line"] = finding.place.line;
                entry["column"] = finding.place.column;
            }
            text.append(first ? "" : ",").append(entry.dump());
            first = false;
        }
        text.append("]}");
    };
    if (file.lengthWarning)
        list("warnings", [](const FileFinding& finding) { return finding.id == SaveCheckIds::DescriptionLength; });
    if (file.trackerChecked)
        list("tracker", [](const FileFinding& finding) { return !finding.id.starts_with("save."); });
    return text + '\n';
}

} // namespace

nlohmann::ordered_json CheckJson(const HeaderData& header, const SaveFindings& save)
{
    nlohmann::ordered_json json;
    json["FilePath"] = TextForJson(header.FilePath);
    json["refusals"] = save.refusals;
    json["missing_username"] = save.missingUserName;
    json["fixups"] = {{"certify_invertnext", save.fixups.certifyInvertNext},
                      {"rotation", save.fixups.rotation},
                      {"write", save.fixups.write},
                      {"color", save.fixups.color}};
    return json;
}

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

std::vector<FileFinding> PlacedFindings(const CheckedFile& file, const HeaderData& header,
                                        const std::string& composedHeader)
{
    // The file is read again only for findings with a place in it (the other fix-ups are about the whole body).
    const auto& save = file.save;
    const bool placed = !save.refusals.empty() || save.missingUserName || save.fixups.color || file.lengthWarning ||
                        !file.tracker.empty();
    const auto bytes = placed ? FileBytes(*header.Part).takeBytes() : std::string();
    const FindingPlaces places(bytes, header, composedHeader);
    auto findings = SaveCheckFindings(file.save, places);
    if (file.lengthWarning)
        findings.push_back(DescriptionLengthWarning(header, places));
    auto tracker = TrackerFileFindings(file.tracker, places);
    findings.insert(findings.end(), std::make_move_iterator(tracker.begin()), std::make_move_iterator(tracker.end()));
    SortByPlace(findings);
    return findings;
}

std::string CheckOutput(const OutputForm& form, const HeaderData& header, const CheckedFile& file,
                        const std::vector<FileFinding>& findings)
{
    switch (form.format) {
    case OutputFormat::Json: return jsonText(header, file, findings);
    case OutputFormat::Sarif: return SarifResultLines(header.FilePath, findings, form.base);
    case OutputFormat::Github: return GithubFindingLines(header.FilePath, findings, form.base);
    case OutputFormat::Text: break;
    }
    return TextFindingLines(header.FilePath, findings);
}
