// SPDX-License-Identifier: MIT
#include "SarifLog.h"

#include <cstdint>
#include <map>
#include <nlohmann/json.hpp>

#include "FieldsJson.h"
#include "PathFromHere.h"

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

std::string fileUri(const std::string& path)
{
    const auto fromHere = SavedPathFromHere(path);
    return (fromHere.belowHere ? "" : "file://") + percentEncoded(fromHere.path);
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

} // namespace

std::string SarifResultLines(const std::string& path, const std::vector<FileFinding>& findings)
{
    const auto uri = fileUri(path);
    std::map<std::pair<std::string, std::string>, int> seen; // the same id and text twice in one file
    std::string lines;
    for (const auto& finding : findings) {
        const auto message = TextForJson(finding.message);
        const auto occurrence = std::to_string(seen[{finding.id, message}]++);
        Json location{{"physicalLocation", {{"artifactLocation", {{"uri", TextForJson(uri)}}}}}};
        if (!finding.place.wholeFile)
            location["physicalLocation"]["region"] = {{"startLine", finding.place.line}};
        const Json result{
            {"ruleId", finding.id},
            {"level", SeverityText(finding.severity)},
            {"message", {{"text", message}}},
            {"locations", Json::array({location})},
            {"partialFingerprints", {{"findingHash/v1", fingerprint({uri, finding.id, message, occurrence})}}}};
        lines += result.dump() + '\n';
    }
    return lines;
}

void WriteSarifLog(std::string_view resultLines, std::ostream& out)
{
    auto results = Json::array();
    std::map<std::string, Json> rules;
    for (std::size_t start = 0; start < resultLines.size();) {
        const auto end = resultLines.find('\n', start);
        auto result = Json::parse(resultLines.substr(start, end - start));
        const auto id = result["ruleId"].get<std::string>();
        rules.try_emplace(id, Json{{"id", id}, {"defaultConfiguration", {{"level", result["level"]}}}});
        results.push_back(std::move(result));
        start = end + 1;
    }
    auto ruleList = Json::array();
    for (auto& [id, rule] : rules) {
        rule["properties"] = {{"source", id.starts_with("save.") ? "save checks" : "Parts Tracker rules"}};
        ruleList.push_back(std::move(rule));
    }
    const Json log{{"$schema", "https://json.schemastore.org/sarif-2.1.0.json"},
                   {"version", "2.1.0"},
                   {"runs", Json::array({{{"tool",
                                           {{"driver",
                                             {{"name", "quillmark-cli"},
                                              {"version", QUILLMARK_VERSION},
                                              {"informationUri", QUILLMARK_HOMEPAGE},
                                              {"rules", std::move(ruleList)}}}}},
                                          {"results", std::move(results)}}})}};
    out << log.dump(2) << '\n';
}
