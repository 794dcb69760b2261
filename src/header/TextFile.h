// SPDX-License-Identifier: MIT
#pragma once

#include <stdexcept>
#include <string>
#include <string_view>

// A part file is text. Pictures, archives and other binary files renamed ".dat" would open as an
// empty header, and a save would put that header in front of their bytes.
class NotTextFileError : public std::runtime_error {
public:
    explicit NotTextFileError(const std::string& path);
};

// Throws NotTextFileError naming path when content is no text file: a NUL byte among its first
// 64 KiB, which no text file holds and nearly every binary file does.
void EnsureTextFile(std::string_view content, const std::string& path);
