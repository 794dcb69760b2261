// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <stdexcept>
#include <string>
#include <string_view>

#include "PartFile.h"

// A part file is text. Pictures, archives and other binary files renamed ".dat" would open as an
// empty header, and a save would put that header in front of their bytes.
class NotTextFileError : public std::runtime_error {
public:
    explicit NotTextFileError(const std::string& path);
};

// How far into a file LooksLikeLDraw looks: enough for any header, and cheap for any file.
inline constexpr std::size_t LookedAtBytes = std::size_t{64} * 1024;

// True when content is no text file: a NUL byte anywhere, which no text file holds and nearly
// every binary file does (holes in a sparse file read as NUL too).
bool LooksBinary(std::string_view content);

// Throws NotTextFileError naming path when content looks binary.
void EnsureTextFile(std::string_view content, const std::string& path);

// EnsureTextFile as the look a read takes at each piece of a file as it arrives: the first NUL
// ends the read.
ReadCheck TextFileCheck(const std::string& path);

// True when the first 64 KiB of content hold an LDraw line: "0", spaces or tabs and a word, or a
// geometry line of type 1 to 5. Notes or a letter saved as ".dat" hold none, and would open as an empty
// part whose save puts a part header in front of them.
bool LooksLikeLDraw(std::string_view content);
