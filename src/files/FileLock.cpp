#include "FileLock.h"

#include <cerrno>
#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>

namespace {

bool sameFile(int fd, const std::string& path)
{
    struct stat locked {
    }, named{};
    return ::fstat(fd, &locked) == 0 && ::stat(path.c_str(), &named) == 0 && locked.st_dev == named.st_dev &&
           locked.st_ino == named.st_ino;
}

} // namespace

FileLock::FileLock(const std::string& path)
{
    for (;;) {
        // Without O_NONBLOCK, opening a FIFO would wait for a writer that may never come.
        FileDescriptor fd(::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK | O_NOCTTY));
        if (!fd.valid())
            return;
        while (::flock(fd.get(), LOCK_EX) != 0)
            if (errno != EINTR)
                return; // a file system without locks: the checks before the rename still hold
        if (sameFile(fd.get(), path)) {
            fd_ = std::move(fd);
            return;
        }
    }
}
