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
#include "OpenPart.h"
#include "QmError.h"

namespace {

void ensureRoomFor(std::size_t size)
{
    if (size > RoomForFiles())
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

std::size_t ReadAt(int fd, char* buffer, std::size_t size, std::size_t offset, const std::string& path)
{
    std::size_t filled = 0;
    while (filled < size) {
        const auto got = ::pread(fd, buffer + filled, size - filled, static_cast<off_t>(offset + filled));
        if (got < 0 && errno == EINTR)
            continue;
        if (got < 0)
            throw OsError(errno, path);
        if (got == 0)
            break;
        filled += static_cast<std::size_t>(got);
    }
    return filled;
}

std::size_t RoomForFiles()
{
    const auto pages = ::sysconf(_SC_PHYS_PAGES);
    const auto pageSize = ::sysconf(_SC_PAGESIZE);
    std::size_t room =
        pages > 0 && pageSize > 0 ? static_cast<std::size_t>(pages) * static_cast<std::size_t>(pageSize) : SIZE_MAX;
    struct rlimit limit {};
    if (::getrlimit(RLIMIT_AS, &limit) == 0 && limit.rlim_cur != RLIM_INFINITY)
        room = std::min(room, static_cast<std::size_t>(limit.rlim_cur));
    return room / 3;
}

MemoryClaims::Claim::~Claim()
{
    if (claims_ != nullptr) {
        const std::lock_guard lock(claims_->mutex_);
        claims_->claimed_ -= size_;
    }
}

MemoryClaims::Claim MemoryClaims::claim(std::size_t size)
{
    const std::lock_guard lock(mutex_);
    if (size > RoomForFiles() - std::min(claimed_, RoomForFiles()))
        throw OutOfMemoryError();
    claimed_ += size;
    return Claim(this, size);
}

FileBytes::FileBytes(const OpenPart& part, const HeadCheck& headCheck) : FileBytes(part.fd(), part.path(), headCheck) {}

FileBytes::FileBytes(const std::string& path)
{
    // Without O_NONBLOCK, opening a FIFO would wait for a writer that may never come.
    const FileDescriptor file(::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK | O_NOCTTY));
    if (!file.valid())
        throw OsError(errno, path);
    *this = FileBytes(file.get(), path);
}

FileBytes::FileBytes(int fd, const std::string& path, const HeadCheck& headCheck)
{
    struct stat info {};
    if (::fstat(fd, &info) != 0)
        throw OsError(errno, path);
    if (!S_ISREG(info.st_mode))
        throw NoRegularFileError(path, S_ISDIR(info.st_mode));
    stamp_ = StampOf(info);
    const auto expected = static_cast<std::size_t>(info.st_size);
    if (headCheck) {
        std::string head(HeadSize, '\0');
        head.resize(ReadAt(fd, head.data(), head.size(), 0, path));
        headCheck(head);
    }
    reserveFor(bytes_, expected);
    for (;;) {
        const auto filled = bytes_.size();
        if (filled == bytes_.capacity()) // the file grew while it was read
            reserveFor(bytes_, 2 * filled);
        // One byte more than the size that fstat saw, so that the end is seen without zeroing
        // more than that; past it, the file grew.
        const auto wanted = filled <= expected ? expected + 1 - filled : ReadStep;
        bytes_.resize(filled + std::min({bytes_.capacity() - filled, ReadStep, wanted}));
        const auto got = ReadAt(fd, bytes_.data() + filled, bytes_.size() - filled, filled, path);
        bytes_.resize(filled + got);
        if (got == 0)
            return;
    }
}
