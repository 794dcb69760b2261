// SPDX-License-Identifier: MIT
#include "CheckOutput.h"

#include <algorithm>

#include "FieldsJson.h"
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
