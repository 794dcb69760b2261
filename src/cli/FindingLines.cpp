// SPDX-License-Identifier: MIT
#include "FindingLines.h"

#include <cstdlib>
#include <filesystem>

#include "ConsoleDialogs.h"
#include "PathFromHere.h"

namespace {

// The runner reads "%", CR and LF in a message as escapes, and ":" and "," in a property too.
std::string workflowEscaped(std::string_view text, bool property)
{
    std::string escaped;
    for (const char c : text) {
        if (c == '%')
            escaped += "%25";
        else if (c == '\r')
            escaped += "%0D";
        else if (c == '\n')
            escaped += "%0A";
        else if (property && c == ':')
            escaped += "%3A";
        else if (property && c == ',')
            escaped += "%2C";
        else
            escaped += c;
    }
    return escaped;
}

// GitHub knows errors, warnings and notices.
const char* workflowCommand(Severity severity)
{
    return severity == Severity::Note ? "notice" : SeverityText(severity);
}

} // namespace

std::string TextFindingLines(const std::string& path, const std::vector<FileFinding>& findings)
{
    const auto shownPath = ShownText(path);
    if (findings.empty())
        return shownPath + ": ok\n";
    std::string lines;
    for (const auto& finding : findings) {
        lines +=
            shownPath + ':' + std::to_string(finding.place.line) + ':' + std::to_string(finding.place.column) + ": ";
        lines += SeverityText(finding.severity);
        lines += ": " + ShownText(finding.message) + " [" + ShownText(finding.id) + "]\n";
    }
    return lines;
}

std::string GithubBaseFolder()
{
    const char* workspace = std::getenv("GITHUB_WORKSPACE");
    if (workspace != nullptr && *workspace != '\0')
        return workspace;
    std::error_code error;
    return std::filesystem::current_path(error).string();
}

std::string GithubFindingLines(const std::string& path, const std::vector<FileFinding>& findings,
                               const std::string& base)
{
    const auto file = workflowEscaped(ShownText(SavedPathFrom(path, base).path), true);
    std::string lines;
    for (const auto& finding : findings) {
        lines += std::string("::") + workflowCommand(finding.severity) + " file=" + file;
        if (!finding.place.wholeFile)
            lines += ",line=" + std::to_string(finding.place.line) + ",col=" + std::to_string(finding.place.column);
        lines += ",title=" + workflowEscaped(finding.id, true) +
                 "::" + workflowEscaped(ShownText(finding.message), false) + '\n';
    }
    return lines;
}
