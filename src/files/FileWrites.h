// SPDX-License-Identifier: MIT
#pragma once

#include <initializer_list>
#include <string>
#include <string_view>

// Writes all of bytes to fd, going on after interruptions; a failure throws QmError naming path.
void WriteAll(int fd, std::string_view bytes, const std::string& path);

// Writes the pieces over the file at path, keeping its inode, cuts it to their length and flushes it.
void OverwriteFile(const std::string& path, std::initializer_list<std::string_view> pieces);

// Flushes the entries of folder, so that a new name in it survives a crash.
void SyncFolder(const std::string& folder);
