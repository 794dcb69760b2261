// SPDX-License-Identifier: MIT
#include "DryRunDiff.h"

#include <algorithm>

#include "ConsoleDialogs.h"
#include "PathFromHere.h"
#include "UnifiedDiff.h"

namespace {

bool isControl(char c)
{
    const auto code = static_cast<unsigned char>(c);
    return code < 0x20 || code == 0x7F;
}

bool needsQuotes(const std::string& name)
{
    const auto slash = name.find('/');
    const bool blankAtStart = name.starts_with(' ') || (slash != std::string::npos && name[slash + 1] == ' ');
    return blankAtStart || name.ends_with(' ') ||
           std::any_of(name.begin(), name.end(), [](char c) { return isControl(c) || c == '"' || c == '\\'; });
}

std::string cQuoted(const std::string& name)
{
    std::string quoted = "\"";
    for (const char c : name) {
        switch (c) {
        case '"': quoted += "\\\""; break;
        case '\\': quoted += "\\\\"; break;
        case '\t': quoted += "\\t"; break;
        case '\n': quoted += "\\n"; break;
        case '\r': quoted += "\\r"; break;
        default:
            if (isControl(c)) {
                const auto code = static_cast<unsigned char>(c);
                quoted += '\\';
                quoted += static_cast<char>('0' + (code >> 6));
                quoted += static_cast<char>('0' + ((code >> 3) & 7));
                quoted += static_cast<char>('0' + (code & 7));
            } else {
                quoted += c;
            }
        }
    }
    return quoted + '"';
}

std::string diffName(const std::string& name)
{
    if (needsQuotes(name))
        return cQuoted(name);
    return name.find(' ') == std::string::npos ? name : name + '\t';
}

} // namespace

DiffNames DiffNamesOf(const std::string& path)
{
    const auto saved = SavedPathFromHere(path);
    if (!saved.belowHere)
        return {diffName(saved.path), diffName(saved.path), false};
    return {diffName("a/" + saved.path), diffName("b/" + saved.path), true};
}

bool DiffedFiles::firstTime(const std::string& name)
{
    const std::lock_guard lock(mutex_);
    return names_.insert(name).second;
}

std::string DryRunDiff(const std::string& path, std::string_view before, std::string_view after, DiffedFiles& diffed,
                       std::string& note)
{
    const auto names = DiffNamesOf(path);
    auto diff = UnifiedDiff(before, after, names.from, names.to);
    if (!diff.empty() && !diffed.firstTime(names.from))
        return {};
    if (!diff.empty() && !names.applies)
        note += "quillmark-cli: " + ShownText(path) +
                " lies outside the current folder: its diff names it by its absolute path, and patch -p1 run "
                "here cannot apply it\n";
    return diff;
}
