// SPDX-License-Identifier: MIT
#pragma once

#include <initializer_list>
#include <string>
#include <string_view>

// Writes all of bytes to fd, going on after interruptions; a failure throws QmError naming path.
void WriteAll(int fd, std::string_view bytes, const std::string& path);

// Writes the pieces over the open file fd from its start, keeping its inode, cuts it to their
// length and flushes it; a failure throws QmError naming path.
void OverwriteFile(int fd, std::initializer_list<std::string_view> pieces, const std::string& path);
