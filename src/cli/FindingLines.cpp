// SPDX-License-Identifier: MIT
#include "FindingLines.h"

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
        lines += shownPath + ':';
        if (!finding.place.wholeFile)
            lines += std::to_string(finding.place.line) + ':';
        lines += ' ';
        lines += SeverityText(finding.severity);
        lines += ' ' + ShownText(finding.id) + ": " + ShownText(finding.message) + '\n';
    }
    return lines;
}

std::string GithubFindingLines(const std::string& path, const std::vector<FileFinding>& findings)
{
    const auto file = workflowEscaped(ShownText(SavedPathFromHere(path).path), true);
    std::string lines;
    for (const auto& finding : findings) {
        lines += std::string("::") + workflowCommand(finding.severity) + " file=" + file;
        if (!finding.place.wholeFile)
            lines += ",line=" + std::to_string(finding.place.line);
        lines += ",title=" + workflowEscaped(finding.id, true) +
                 "::" + workflowEscaped(ShownText(finding.message), false) + '\n';
    }
    return lines;
}
