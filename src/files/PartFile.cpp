#include "PartFile.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <unistd.h>

#include "FileDescriptor.h"
#include "LargeBuffer.h"
#include "QmError.h"

namespace {

// Opening a file holds its bytes, the body copied out of them and the composed text: about three
// times its size. A file that cannot fit three times into memory (or the process's address-space
// limit) is refused up front rather than failing half-way.
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

std::unique_ptr<char[]> allocate(std::size_t size)
{
    ensureRoomFor(size);
    auto buffer = std::make_unique_for_overwrite<char[]>(size);
    AdviseLargeBuffer(buffer.get(), size);
    return buffer;
}

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
        throw PathFileAccessError();
    stamp_ = StampOf(info);
    // One byte more than the size that fstat saw, so that reaching the end needs no second buffer.
    std::size_t capacity = static_cast<std::size_t>(info.st_size) + 1;
    bytes_ = allocate(capacity);
    for (;;) {
        if (size_ == capacity) { // the file grew while it was read
            auto larger = allocate(capacity * 2);
            std::memcpy(larger.get(), bytes_.get(), size_);
            bytes_ = std::move(larger);
            capacity *= 2;
        }
        const auto got = ::read(file.get(), bytes_.get() + size_, capacity - size_);
        if (got < 0) {
            if (errno == EINTR)
                continue;
            throw OsError(errno, path);
        }
        if (got == 0)
            return;
        size_ += static_cast<std::size_t>(got);
    }
}
