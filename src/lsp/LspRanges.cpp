// SPDX-License-Identifier: MIT
#include "LspRanges.h"

#include "RuleTexts.h"
#include "SarifLog.h"

namespace {

// The protocol's DiagnosticSeverity.
int severityNumber(Severity severity)
{
    switch (severity) {
    case Severity::Error: return 1;
    case Severity::Warning: return 2;
    case Severity::Note: break;
    }
    return 3; // Information
}

} // namespace

nlohmann::json PositionJson(TextPosition position)
{
    return {{"line", position.line}, {"character", position.character}};
}

std::optional<TextPosition> PositionFromJson(const nlohmann::json& json)
{
    if (!json.is_object() || !json.contains("line") || !json.contains("character") ||
        !json["line"].is_number_unsigned() || !json["character"].is_number_unsigned())
        return std::nullopt;
    return TextPosition{json["line"].get<std::size_t>(), json["character"].get<std::size_t>()};
}

nlohmann::json LineRangeJson(const Document& document, std::size_t line, PositionEncoding encoding)
{
    const auto& lines = document.lines();
    line = std::min(line, lines.lineCount() - 1);
    const auto end = lines.positionOf(document.text, lines.contentEnd(document.text, line), encoding);
    return {{"start", PositionJson({line, 0})}, {"end", PositionJson(end)}};
}

std::size_t LineOfFinding(const Document& document, const FileFinding& finding)
{
    const auto& place = finding.place;
    return place.wholeFile ? 0 : document.lines().positionOf(document.text, place.begin, PositionEncoding::Utf8).line;
}

nlohmann::json FindingRangeJson(const Document& document, const FileFinding& finding, PositionEncoding encoding)
{
    const auto& place = finding.place;
    if (place.wholeFile || place.begin >= place.end)
        return LineRangeJson(document, LineOfFinding(document, finding), encoding);
    const auto& lines = document.lines();
    return {{"start", PositionJson(lines.positionOf(document.text, place.begin, encoding))},
            {"end", PositionJson(lines.positionOf(document.text, place.end, encoding))}};
}

nlohmann::json DiagnosticJson(const Document& document, const FileFinding& finding, PositionEncoding encoding)
{
    nlohmann::json diagnostic{{"range", FindingRangeJson(document, finding, encoding)},
                              {"severity", severityNumber(finding.severity)},
                              {"code", finding.id},
                              {"source", "quillmark"},
                              {"message", finding.message}};
    if (const auto* rule = FindRuleText(finding.id))
        diagnostic["codeDescription"] = {{"href", RuleHelpUri(*rule)}};
    return diagnostic;
}
