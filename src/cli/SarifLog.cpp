// SPDX-License-Identifier: MIT
#include "SarifLog.h"

#include <cstdint>
#include <map>
#include <nlohmann/json.hpp>

#include "FieldsJson.h"
#include "PathFromHere.h"
#include "RuleTexts.h"

namespace {

using Json = nlohmann::ordered_json;

// A URI reference: every byte but the unreserved ones and "/" as %XX.
std::string percentEncoded(std::string_view path)
{
    constexpr char Hex[] = "0123456789ABCDEF";
    std::string encoded;
    for (const char c : path) {
        const auto code = static_cast<unsigned char>(c);
        const bool plain = (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') || (c >= '0' && c <= '9') || c == '-' ||
                           c == '.' || c == '_' || c == '~' || c == '/';
        if (plain) {
            encoded += c;
        } else {
            encoded += '%';
            encoded += Hex[code >> 4];
            encoded += Hex[code & 0xF];
        }
    }
    return encoded;
}

// The URI of the file at path and whether it is relative to %SRCROOT%.
std::pair<std::string, bool> fileUri(const std::string& path, const std::string& base)
{
    const auto fromBase = SavedPathFrom(path, base);
    return {(fromBase.belowHere ? "" : "file://") + percentEncoded(fromBase.path), fromBase.belowHere};
}

std::size_t ruleIndex(std::string_view id)
{
    const auto rules = RuleTexts();
    const auto* rule = FindRuleText(id);
    return rule != nullptr ? static_cast<std::size_t>(rule - rules.data()) : rules.size();
}

Json ruleJson(const RuleText& rule)
{
    const auto help = ExplainText(rule);
    return Json{{"id", rule.id},
                {"shortDescription", {{"text", rule.title}}},
                {"fullDescription", {{"text", RuleDescription(rule)}}},
                {"help", {{"text", help}, {"markdown", RuleMarkdown(rule)}}},
                {"helpUri", RuleHelpUri(rule)},
                {"properties",
                 {{"source", std::string_view(rule.id).starts_with("save.") ? "save checks" : "Parts Tracker rules"}}}};
}

// FNV-1a: the same finding in the same file gets the same print in every run, wherever its
// line moves.
std::string fingerprint(std::initializer_list<std::string_view> parts)
{
    std::uint64_t hash = 14695981039346656037ULL;
    for (const auto part : parts) {
        for (const char c : part)
            hash = (hash ^ static_cast<unsigned char>(c)) * 1099511628211ULL;
        hash = (hash ^ 0xFF) * 1099511628211ULL; // between the parts
    }
    constexpr char Hex[] = "0123456789abcdef";
    std::string text(16, '0');
    for (int k = 15; k >= 0; --k, hash >>= 4)
        text[static_cast<std::size_t>(k)] = Hex[hash & 0xF];
    return text;
}

// The file URI of a folder, ending in "/" as a base URI must.
std::string folderUri(const std::string& folder)
{
    auto uri = "file://" + percentEncoded(folder);
    if (!uri.ends_with('/'))
        uri += '/';
    return uri;
}

} // namespace

std::string RuleHelpUri(const RuleText& rule)
{
    return std::string(QUILLMARK_HOMEPAGE) + "/blob/main/docs/rules.md#" + RuleAnchor(rule);
}

std::string SarifResultLines(const std::string& path, const std::vector<FileFinding>& findings, const std::string& base)
{
    const auto [uri, belowBase] = fileUri(path, base);
    std::map<std::pair<std::string, std::string>, int> seen; // the same id and text twice in one file
    std::string lines;
    for (const auto& finding : findings) {
        const auto message = TextForJson(finding.message);
        const auto occurrence = std::to_string(seen[{finding.id, message}]++);
        Json artifact{{"uri", TextForJson(uri)}};
        if (belowBase)
            artifact["uriBaseId"] = "%SRCROOT%";
        Json location{{"physicalLocation", {{"artifactLocation", std::move(artifact)}}}};
        if (!finding.place.wholeFile)
            location["physicalLocation"]["region"] = {{"startLine", finding.place.line},
                                                      {"startColumn", finding.place.column}};
        Json result{{"ruleId", finding.id}};
        if (const auto index = ruleIndex(finding.id); index < RuleTexts().size())
            result["ruleIndex"] = index;
        result["level"] = SeverityText(finding.severity);
        result["message"] = {{"text", message}};
        result["locations"] = Json::array({location});
        result["partialFingerprints"] = {{"findingHash/v1", fingerprint({uri, finding.id, message, occurrence})}};
        lines += result.dump() + '\n';
    }
    return lines;
}

SarifLogWriter::SarifLogWriter(std::ostream& out, const std::string& base) : out_(out)
{
    auto rules = Json::array();
    for (const auto& rule : RuleTexts())
        rules.push_back(ruleJson(rule));
    const Json run{{"tool",
                    {{"driver",
                      {{"name", "quillmark-cli"},
                       {"version", QUILLMARK_VERSION},
                       {"informationUri", QUILLMARK_HOMEPAGE},
                       {"rules", std::move(rules)}}}}},
                   {"originalUriBaseIds", {{"%SRCROOT%", {{"uri", TextForJson(folderUri(base))}}}}}};
    auto head = run.dump();
    head.pop_back(); // the run goes on with its results
    out_ << R"({"$schema":"https://json.schemastore.org/sarif-2.1.0.json","version":"2.1.0","runs":[)" << head
         << ",\"results\":[";
}

void SarifLogWriter::write(std::string_view resultLines)
{
    for (std::size_t start = 0; start < resultLines.size();) {
        const auto end = resultLines.find('\n', start);
        out_ << (first_ ? "\n" : ",\n") << resultLines.substr(start, end - start);
        first_ = false;
        start = end + 1;
    }
}

void SarifLogWriter::finish() { out_ << "\n]}]}\n"; }
