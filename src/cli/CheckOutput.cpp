// SPDX-License-Identifier: MIT
#include "CheckOutput.h"

#include "FieldsJson.h"
#include "SarifLog.h"

nlohmann::ordered_json CheckJson(const HeaderData& header, const SaveFindings& save,
                                 const std::vector<FileFinding>* tracker)
{
    nlohmann::ordered_json json;
    json["FilePath"] = TextForJson(header.FilePath);
    json["refusals"] = save.refusals;
    json["missing_username"] = save.missingUserName;
    json["fixups"] = {{"certify_invertnext", save.fixups.certifyInvertNext},
                      {"rotation", save.fixups.rotation},
                      {"write", save.fixups.write},
                      {"color", save.fixups.color}};
    if (tracker != nullptr) {
        json["tracker"] = nlohmann::ordered_json::array();
        for (const auto& finding : *tracker) {
            auto& entry = json["tracker"].emplace_back(nlohmann::ordered_json{
                {"id", finding.id}, {"level", SeverityText(finding.severity)}, {"text", finding.message}});
            if (!finding.place.wholeFile) {
                entry["line"] = finding.place.line;
                entry["column"] = finding.place.column;
            }
        }
    }
    return json;
}

std::string CheckOutput(OutputFormat format, const HeaderData& header, const RecordCheck& check,
                        std::string_view fileBytes, bool tracker)
{
    if (format == OutputFormat::Json) {
        const auto trackerFindings =
            TrackerFileFindings(check.tracker, FindingPlaces(fileBytes, header, check.composed));
        return CheckJson(header, check.save, tracker ? &trackerFindings : nullptr).dump() + '\n';
    }
    const auto findings = FindingsOfRecord(header, check, fileBytes, tracker);
    switch (format) {
    case OutputFormat::Sarif: return SarifResultLines(header.FilePath, findings);
    case OutputFormat::Github: return GithubFindingLines(header.FilePath, findings);
    case OutputFormat::Text:
    case OutputFormat::Json: break;
    }
    return TextFindingLines(header.FilePath, findings);
}
