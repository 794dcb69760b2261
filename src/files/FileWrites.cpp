// SPDX-License-Identifier: MIT
#include "FileWrites.h"

#include <cerrno>
#include <fcntl.h>
#include <unistd.h>

#include "FileDescriptor.h"
#include "QmError.h"

void WriteAll(int fd, std::string_view bytes, const std::string& path)
{
    while (!bytes.empty()) {
        const auto written = ::write(fd, bytes.data(), bytes.size());
        if (written < 0) {
            if (errno == EINTR)
                continue;
            throw OsError(errno, path);
        }
        bytes.remove_prefix(static_cast<std::size_t>(written));
    }
}

void OverwriteFile(const std::string& path, std::initializer_list<std::string_view> pieces)
{
    const FileDescriptor file(::open(path.c_str(), O_WRONLY | O_CLOEXEC | O_NOCTTY));
    if (!file.valid())
        throw OsError(errno, path);
    std::size_t size = 0;
    for (const auto piece : pieces) {
        WriteAll(file.get(), piece, path);
        size += piece.size();
    }
    if (::ftruncate(file.get(), static_cast<off_t>(size)) != 0 || ::fsync(file.get()) != 0)
        throw OsError(errno, path);
}

void SyncFolder(const std::string& folder)
{
    const FileDescriptor handle(::open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    // Best effort: some file systems cannot sync a folder, and the file itself is in place.
    if (handle.valid())
        ::fsync(handle.get());
}
