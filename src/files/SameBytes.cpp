// SPDX-License-Identifier: MIT
#include "SameBytes.h"

#include <sys/stat.h>

#include <cerrno>
#include <cstring>
#include <numeric>
#include <vector>

#include "PartFile.h"
#include "QmError.h"

namespace {

constexpr std::size_t ReadStep = std::size_t{256} * 1024;

// Reads up to size bytes at offset, fewer only at the end of the file; -1 when reading fails.
ssize_t readFully(int fd, char* buffer, std::size_t size, std::size_t offset)
{
    try {
        return static_cast<ssize_t>(ReadAt(fd, buffer, size, offset, {}));
    } catch (const QmError&) {
        return -1;
    }
}

// Whether the file's next bytes are those of piece.
bool nextBytesAre(int fd, std::size_t& offset, std::string_view piece, std::vector<char>& buffer)
{
    while (!piece.empty()) {
        const auto step = std::min(piece.size(), buffer.size());
        if (readFully(fd, buffer.data(), step, offset) != static_cast<ssize_t>(step) ||
            std::memcmp(buffer.data(), piece.data(), step) != 0)
            return false;
        piece.remove_prefix(step);
        offset += step;
    }
    return true;
}

} // namespace

bool FileHoldsExactly(int fd, std::span<const std::string_view> pieces)
{
    struct stat info {};
    if (::fstat(fd, &info) != 0 || !S_ISREG(info.st_mode))
        return false;
    const auto size = std::accumulate(pieces.begin(), pieces.end(), std::size_t{0},
                                      [](std::size_t sum, std::string_view piece) { return sum + piece.size(); });
    if (static_cast<std::size_t>(info.st_size) != size)
        return false;
    std::vector<char> buffer(ReadStep);
    std::size_t offset = 0;
    for (const auto piece : pieces)
        if (!nextBytesAre(fd, offset, piece, buffer))
            return false;
    char extra = 0;
    return readFully(fd, &extra, 1, offset) == 0; // grown since fstat: not the same
}
