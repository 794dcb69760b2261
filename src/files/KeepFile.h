// SPDX-License-Identifier: MIT
#pragma once

#include <cstdint>
#include <initializer_list>
#include <string>
#include <string_view>

struct stat;

// A file that must keep its inode is rewritten in place. Before that, a keep file takes a whole
// copy of its old bytes, on disk, together with a record of the rewrite: which process does it,
// and the size and checksum of the new text. The keep file is named after the device and inode
// of the file it keeps, so that any later open finds it with one look, whatever the file's name.
// It is removed when the rewrite is done; when the rewriting process was killed, the next open
// or save finishes the rewrite's undoing (RestoreInterruptedRewrite).

struct TextFingerprint {
    std::uint64_t size = 0;
    std::uint64_t checksum = 0;
    bool operator==(const TextFingerprint&) const = default;
};
TextFingerprint FingerprintOf(std::initializer_list<std::string_view> pieces);

// Writes the keep file for the file whose status is part into folder and returns its path.
std::string WriteKeepFile(const std::string& folder, const struct stat& part, std::string_view oldBytes,
                          const TextFingerprint& newText);

// The folder where this user keeps the keep files of the files in folder: the folder itself, or
// the temporary folder when he may not create files there.
std::string KeepFolderFor(const std::string& folder);

// True when a keep file for the file at path exists: a look at its name, nothing read.
bool HasKeepFile(const std::string& path);

// Looks for the keep file of the file at path left by a process that no longer runs. When the
// file does not hold that rewrite's complete new text, writes the kept old bytes back over it.
// Removes the keep file. True when old bytes were written back. The caller holds the file's lock.
bool RestoreInterruptedRewrite(const std::string& path);
