// SPDX-License-Identifier: MIT
#include "FileLock.h"

#include <cerrno>
#include <csignal>
#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <thread>

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

void FileLock::waitUntilOthersClosed(std::chrono::milliseconds patience) const
{
    // Someone opening the file while the lease is held is announced with SIGURG, which is ignored,
    // instead of SIGIO, which would end the program.
    if (!fd_.valid() || ::fcntl(fd_.get(), F_SETSIG, SIGURG) != 0)
        return;
    const auto giveUp = std::chrono::steady_clock::now() + patience;
    while (::fcntl(fd_.get(), F_SETLEASE, F_WRLCK) != 0) {
        if (errno != EAGAIN || std::chrono::steady_clock::now() >= giveUp)
            return;
        std::this_thread::sleep_for(std::chrono::milliseconds(1));
    }
    ::fcntl(fd_.get(), F_SETLEASE, F_UNLCK);
}
