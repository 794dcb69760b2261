// SPDX-License-Identifier: MIT
#include "PartFile.h"

#include <algorithm>
#include <cerrno>
#include <fcntl.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <unistd.h>

#include "FileDescriptor.h"
#include "LargeBuffer.h"
#include "QmError.h"

namespace {

// Opening a file holds its bytes (which become the body), the header taken out of them and the
// composed text: up to about three times its size. A file that cannot fit three times into memory
// (or the process's address-space limit) is refused up front rather than failing half-way.
void ensureRoomFor(std::size_t size)
{
    const auto pages = ::sysconf(_SC_PHYS_PAGES);
    const auto pageSize = ::sysconf(_SC_PAGESIZE);
    std::size_t room =
        pages > 0 && pageSize > 0 ? static_cast<std::size_t>(pages) * static_cast<std::size_t>(pageSize) : SIZE_MAX;
    struct rlimit limit {};
    if (::getrlimit(RLIMIT_AS, &limit) == 0 && limit.rlim_cur != RLIM_INFINITY)
        room = std::min(room, static_cast<std::size_t>(limit.rlim_cur));
    if (size > room / 3)
        throw OutOfMemoryError();
}

// Room for size bytes, and behind them for every byte to become two when the line ends are
// turned into CR LF, plus one more line end. Memory the conversion does not use is never touched
// and costs address space only.
void reserveFor(std::string& bytes, std::size_t size)
{
    ensureRoomFor(size);
    bytes.reserve(2 * size + 2);
    AdviseLargeBuffer(bytes.data(), bytes.capacity());
}

// A string cannot grow without writing its new bytes, so it grows by steps that stay in the
// cache before read() overwrites them.
constexpr std::size_t ReadStep = std::size_t{256} * 1024;

} // namespace

FileBytes::FileBytes(const std::string& path)
{
    // Without O_NONBLOCK, opening a FIFO would wait for a writer that may never come.
    const FileDescriptor file(::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK | O_NOCTTY));
    if (!file.valid())
        throw OsError(errno, path);
    struct stat info {};
    if (::fstat(file.get(), &info) != 0)
        throw OsError(errno, path);
    if (!S_ISREG(info.st_mode))
        throw NoRegularFileError(path, S_ISDIR(info.st_mode));
    stamp_ = StampOf(info);
    const auto expected = static_cast<std::size_t>(info.st_size);
    reserveFor(bytes_, expected);
    for (;;) {
        const auto filled = bytes_.size();
        if (filled == bytes_.capacity()) // the file grew while it was read
            reserveFor(bytes_, 2 * filled);
        // One byte more than the size that fstat saw, so that the end is seen without zeroing
        // more than that; past it, the file grew.
        const auto wanted = filled <= expected ? expected + 1 - filled : ReadStep;
        bytes_.resize(filled + std::min({bytes_.capacity() - filled, ReadStep, wanted}));
        const auto got = ::read(file.get(), bytes_.data() + filled, bytes_.size() - filled);
        const int readError = errno;
        bytes_.resize(filled + static_cast<std::size_t>(std::max<ssize_t>(got, 0)));
        if (got < 0) {
            if (readError == EINTR)
                continue;
            throw OsError(readError, path);
        }
        if (got == 0)
            return;
    }
}
