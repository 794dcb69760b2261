// SPDX-License-Identifier: MIT
#pragma once

#include <cstdint>
#include <string>

struct stat;

// What identifies the content of a file on disk without reading it: where it lives (device and
// inode), its size and its modification time. Another program's write, a checkout that
// replaces the file, or its removal all give a different stamp.
struct FileStamp {
    bool exists = false;
    std::uint64_t device = 0;
    std::uint64_t inode = 0;
    std::int64_t size = 0;
    std::int64_t modifiedSeconds = 0;
    std::int64_t modifiedNanoseconds = 0;

    bool operator==(const FileStamp&) const = default;
};

FileStamp StampOf(const struct stat& info);
