// SPDX-License-Identifier: MIT
#include "KeepFile.h"

#include <array>
#include <cerrno>
#include <cinttypes>
#include <cstdio>
#include <fcntl.h>
#include <filesystem>
#include <sys/stat.h>
#include <unistd.h>

#include "FileWrites.h"
#include "Folders.h"
#include "NewFile.h"
#include "PartFile.h"
#include "QmError.h"

namespace {

constexpr std::string_view KeepPrefix = ".quillmark-keep-";

std::string keepPathIn(const std::string& folder, const struct stat& part)
{
    return folder + "/" + std::string(KeepPrefix) + std::to_string(part.st_dev) + "-" + std::to_string(part.st_ino);
}

// The first line of a keep file: "quillmark-keep <pid> <new size> <new checksum>".
std::string recordLine(const TextFingerprint& newText)
{
    char line[96];
    std::snprintf(line, sizeof line, "quillmark-keep %ld %" PRIu64 " %" PRIu64 "\n", static_cast<long>(::getpid()),
                  newText.size, newText.checksum);
    return line;
}

struct KeepRecord {
    long pid = 0;
    TextFingerprint newText;
    std::string_view oldBytes;
};

bool parseRecord(std::string_view keep, KeepRecord& record)
{
    const auto end = keep.find('\n');
    if (end == std::string_view::npos)
        return false;
    const std::string line(keep.substr(0, end));
    if (std::sscanf(line.c_str(), "quillmark-keep %ld %" SCNu64 " %" SCNu64, &record.pid, &record.newText.size,
                    &record.newText.checksum) != 3)
        return false;
    record.oldBytes = keep.substr(end + 1);
    return true;
}

// A keep file made by someone who may write the part anyway: this user, the part's owner, its
// group when the group may write it, anyone when everyone may. Never one that another user put
// in a shared temporary folder to have its bytes written into a part he may not write.
bool mayStandFor(const std::string& keepPath, const struct stat& part)
{
    struct stat keep {};
    if (::lstat(keepPath.c_str(), &keep) != 0 || !S_ISREG(keep.st_mode))
        return false;
    return keep.st_uid == ::geteuid() || keep.st_uid == part.st_uid ||
           (keep.st_gid == part.st_gid && (part.st_mode & S_IWGRP) != 0) || (part.st_mode & S_IWOTH) != 0;
}

// Where the keep file of the file at path may be: which of the two it is depends on the rights of
// the user who saved, not of the one who looks.
std::array<std::string, 2> keepFoldersFor(const std::string& path)
{
    return {FolderOf(path), std::filesystem::temp_directory_path().string()};
}

} // namespace

TextFingerprint FingerprintOf(std::initializer_list<std::string_view> pieces)
{
    // FNV-1a: enough to tell the complete new text from a torn one.
    TextFingerprint fingerprint{0, 14695981039346656037ull};
    for (const auto piece : pieces) {
        fingerprint.size += piece.size();
        for (const unsigned char byte : piece)
            fingerprint.checksum = (fingerprint.checksum ^ byte) * 1099511628211ull;
    }
    return fingerprint;
}

std::string KeepFolderFor(const std::string& folder)
{
    const bool writable = ::faccessat(AT_FDCWD, folder.c_str(), W_OK | X_OK, AT_EACCESS) == 0;
    return writable ? folder : std::filesystem::temp_directory_path().string();
}

std::string WriteKeepFile(const std::string& folder, const struct stat& part, std::string_view oldBytes,
                          const TextFingerprint& newText)
{
    const auto path = keepPathIn(folder, part);
    NewFile keep(folder, path);
    keep.write({recordLine(newText), oldBytes});
    keep.setMode(0600);
    keep.sync();
    if (!keep.linkAs(path))
        throw OsError(EEXIST, path);
    return path;
}

bool HasKeepFile(const std::string& path)
{
    struct stat part {
    }, keep{};
    if (::stat(path.c_str(), &part) != 0)
        return false;
    for (const auto& keepFolder : keepFoldersFor(path))
        if (::lstat(keepPathIn(keepFolder, part).c_str(), &keep) == 0)
            return true;
    return false;
}

bool RestoreInterruptedRewrite(const std::string& path)
{
    struct stat part {};
    if (::stat(path.c_str(), &part) != 0)
        return false;
    for (const auto& keepFolder : keepFoldersFor(path)) {
        const auto keepPath = keepPathIn(keepFolder, part);
        KeepRecord record;
        if (!mayStandFor(keepPath, part))
            continue;
        const FileBytes keep(keepPath);
        if (!parseRecord(keep.view(), record) || !ProcessIsGone(record.pid))
            continue;
        const FileBytes now(path);
        const bool untouched = now.view() == record.oldBytes;
        const bool complete = FingerprintOf({now.view()}) == record.newText;
        if (!untouched && !complete)
            OverwriteFile(path, {record.oldBytes});
        ::unlink(keepPath.c_str());
        return !untouched && !complete;
    }
    return false;
}
