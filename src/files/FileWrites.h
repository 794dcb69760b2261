// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <initializer_list>
#include <string>
#include <string_view>

// Writes all of bytes to fd, going on after interruptions; a failure throws QmError naming path.
void WriteAll(int fd, std::string_view bytes, const std::string& path);

// Writes the pieces over the open file fd from its start, keeping its inode; returns their length.
// A failure throws QmError naming path.
std::size_t WriteFromStart(int fd, std::initializer_list<std::string_view> pieces, const std::string& path);
// Cuts the open file fd to size and flushes it; a failure throws QmError naming path.
void CutAndFlush(int fd, std::size_t size, const std::string& path);

// Both: the pieces over the file, cut to their length and flushed.
void OverwriteFile(int fd, std::initializer_list<std::string_view> pieces, const std::string& path);
