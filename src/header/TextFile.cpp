// SPDX-License-Identifier: MIT
#include "TextFile.h"

NotTextFileError::NotTextFileError(const std::string& path) : std::runtime_error(path + " is not an LDraw text file.")
{
}

void EnsureTextFile(std::string_view content, const std::string& path)
{
    constexpr std::size_t lookedAt = 64 * 1024;
    if (content.substr(0, lookedAt).find('\0') != std::string_view::npos)
        throw NotTextFileError(path);
}
