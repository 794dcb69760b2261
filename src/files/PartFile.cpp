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

// Room for size bytes, and behind them for every byte to become two when the line ends are
// turned into CR LF, plus one more line end. Memory the conversion does not use is never touched
// and costs address space only.
void reserveFor(std::string& bytes, std::size_t size, MemoryClaims* memory)
{
    if (size > (memory != nullptr ? memory->room() : RoomForFiles()))
        throw OutOfMemoryError();
    bytes.reserve(2 * size + 2);
    AdviseLargeBuffer(bytes.data(), bytes.capacity());
}

// A string cannot grow without writing its new bytes, so it grows by steps that stay in the
// cache before read() overwrites them.
constexpr std::size_t ReadStep = std::size_t{256} * 1024;

// A hole in a sparse file reads as zeros that take no disk and no memory until read: its first
// byte is shown to the check before room for the whole file is taken. The descriptor's offset,
// which lseek moves, is put back: it may be shared.
void checkFirstHole(int fd, std::size_t size, const std::string& path, const ReadCheck& check)
{
    const auto offset = ::lseek(fd, 0, SEEK_CUR);
    const auto hole = ::lseek(fd, static_cast<off_t>(HeadSize), SEEK_HOLE);
    if (offset >= 0)
        ::lseek(fd, offset, SEEK_SET);
    char first = 0;
    if (hole >= 0 && static_cast<std::size_t>(hole) < size &&
        ReadAt(fd, &first, 1, static_cast<std::size_t>(hole), path) == 1)
        check(std::string_view(&first, 1));
}

} // namespace

std::size_t ReadAt(int fd, char* buffer, std::size_t size, std::size_t offset, const std::string& path)
{
    std::size_t filled = 0;
    while (filled < size) {
        const auto got = ReadSome(fd, buffer + filled, size - filled, offset + filled, path);
        if (got == 0)
            break;
        filled += got;
    }
    return filled;
}

std::size_t ReadSome(int fd, char* buffer, std::size_t size, std::size_t offset, const std::string& path)
{
    for (;;) {
        const auto got = ::pread(fd, buffer, size, static_cast<off_t>(offset));
        if (got >= 0)
            return static_cast<std::size_t>(got);
        if (errno != EINTR)
            throw OsError(errno, path);
    }
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
    const auto room = roomLocked();
    if (size > room - std::min(claimed_, room))
        throw OutOfMemoryError();
    claimed_ += size;
    return Claim(this, size);
}

std::size_t MemoryClaims::room()
{
    const std::lock_guard lock(mutex_);
    return roomLocked();
}

std::size_t MemoryClaims::roomLocked()
{
    const auto now = std::chrono::steady_clock::now();
    if (room_ == 0 || now - asked_ >= std::chrono::seconds(1)) {
        room_ = RoomForFiles();
        asked_ = now;
    }
    return room_;
}

FileBytes::FileBytes(const OpenPart& part, const ReadCheck& check, MemoryClaims* memory)
    : FileBytes(part.fd(), part.path(), check, memory)
{
}

FileBytes::FileBytes(const std::string& path)
{
    // Without O_NONBLOCK, opening a FIFO would wait for a writer that may never come.
    const FileDescriptor file(::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK | O_NOCTTY));
    if (!file.valid())
        throw OsError(errno, path);
    *this = FileBytes(file.get(), path);
}

FileBytes::FileBytes(int fd, const std::string& path, const ReadCheck& check, MemoryClaims* memory)
{
    struct stat info {};
    if (::fstat(fd, &info) != 0)
        throw OsError(errno, path);
    if (!S_ISREG(info.st_mode))
        throw NoRegularFileError(path, S_ISDIR(info.st_mode));
    stamp_ = StampOf(info);
    const auto expected = static_cast<std::size_t>(info.st_size);
    // A file longer than its head shows the head to the check before room for the rest is taken;
    // a shorter one is checked once read.
    std::size_t checked = 0;
    if (check && expected >= HeadSize) {
        std::string head(HeadSize, '\0');
        head.resize(ReadAt(fd, head.data(), head.size(), 0, path));
        check(head);
        checked = head.size();
        checkFirstHole(fd, expected, path, check);
    }
    reserveFor(bytes_, expected, memory);
    for (;;) {
        const auto filled = bytes_.size();
        if (filled == bytes_.capacity()) // the file grew while it was read
            reserveFor(bytes_, 2 * filled, memory);
        // One byte more than the size that fstat saw, so that the end is seen without zeroing
        // more than that; past it, the file grew.
        const auto wanted = filled <= expected ? expected + 1 - filled : ReadStep;
        const auto asked = std::min({bytes_.capacity() - filled, ReadStep, wanted});
        bytes_.resize(filled + asked);
        const auto got = ReadSome(fd, bytes_.data() + filled, asked, filled, path);
        bytes_.resize(filled + got);
        if (check && filled + got > checked) {
            check(std::string_view(bytes_).substr(checked));
            checked = filled + got;
        }
        // A read that stops short exactly at the end that fstat saw has met it: no further call
        // needs to say so.
        if (got == 0 || (got < asked && filled + got == expected))
            return;
    }
}
