// SPDX-License-Identifier: MIT
#include "TextFile.h"

namespace {

bool isBlank(char c) { return c == ' ' || c == '\t'; }

// A line that the LDraw format knows, whatever comes after its first words.
bool isLDrawLine(std::string_view line)
{
    const auto start = line.find_first_not_of(" \t");
    if (start == std::string_view::npos || start + 1 >= line.size() || !isBlank(line[start + 1]))
        return false;
    const char type = line[start];
    if (type >= '1' && type <= '5')
        return true;
    return type == '0' && line.find_first_not_of(" \t", start + 1) != std::string_view::npos;
}

} // namespace

NotTextFileError::NotTextFileError(const std::string& path) : std::runtime_error(path + " is not an LDraw text file.")
{
}

bool LooksBinary(std::string_view content) { return content.find('\0') != std::string_view::npos; }

void EnsureTextFile(std::string_view content, const std::string& path)
{
    if (LooksBinary(content))
        throw NotTextFileError(path);
}

bool LooksLikeLDraw(std::string_view content)
{
    content = content.substr(0, LookedAtBytes);
    while (!content.empty()) {
        const auto end = content.find_first_of("\r\n");
        if (isLDrawLine(content.substr(0, end)))
            return true;
        content.remove_prefix(end == std::string_view::npos ? content.size() : end + 1);
    }
    return false;
}

ReadCheck TextFileCheck(const std::string& path)
{
    return [path](std::string_view head) { EnsureTextFile(head, path); };
}
