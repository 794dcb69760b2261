// SPDX-License-Identifier: MIT
#include "FileWrites.h"

#include <cerrno>
#include <unistd.h>

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

std::size_t WriteFromStart(int fd, std::initializer_list<std::string_view> pieces, const std::string& path)
{
    if (::lseek(fd, 0, SEEK_SET) != 0)
        throw OsError(errno, path);
    std::size_t size = 0;
    for (const auto piece : pieces) {
        WriteAll(fd, piece, path);
        size += piece.size();
    }
    return size;
}

void CutAndFlush(int fd, std::size_t size, const std::string& path)
{
    if (::ftruncate(fd, static_cast<off_t>(size)) != 0 || ::fsync(fd) != 0)
        throw OsError(errno, path);
}

void OverwriteFile(int fd, std::initializer_list<std::string_view> pieces, const std::string& path)
{
    CutAndFlush(fd, WriteFromStart(fd, pieces, path), path);
}
