// SPDX-License-Identifier: MIT
#include "FileLock.h"

#include <cerrno>
#include <csignal>
#include <fcntl.h>
#include <sys/file.h>
#include <thread>

#include "OpenPart.h"

namespace {

constexpr std::chrono::milliseconds LockPoll{20};

} // namespace

FileLockedError::FileLockedError(const std::string& path)
    : QmError(ErrorNumber::PathFileAccessError, path + " is locked by another program")
{
}

InterruptedError::InterruptedError() : QmError(ErrorNumber::PathFileAccessError, "interrupted") {}

FileLock::FileLock(const OpenPart& part, const LockWait& wait) : part_(part)
{
    const auto giveUp = std::chrono::steady_clock::now() + wait.patience;
    bool said = false;
    while (::flock(part.fd(), LOCK_EX | LOCK_NB) != 0) {
        if (errno == EINTR)
            continue;
        if (errno != EWOULDBLOCK)
            return; // a file system without locks: the checks before the rename still hold
        if (wait.interrupted && wait.interrupted())
            throw InterruptedError();
        if (std::chrono::steady_clock::now() >= giveUp)
            throw FileLockedError(part.path());
        if (!said && wait.waiting)
            wait.waiting(part.path());
        said = true;
        std::this_thread::sleep_for(LockPoll);
    }
    locked_ = true;
}

FileLock::~FileLock()
{
    // The document keeps the part open after a save: its lock must not outlive the save.
    if (locked_)
        ::flock(part_.fd(), LOCK_UN);
}

void FileLock::waitUntilOthersClosed(std::chrono::milliseconds patience) const
{
    // Someone opening the file while the lease is held is announced with SIGURG, which is ignored,
    // instead of SIGIO, which would end the program.
    const int fd = part_.fd();
    if (!locked_ || ::fcntl(fd, F_SETSIG, SIGURG) != 0)
        return;
    const auto giveUp = std::chrono::steady_clock::now() + patience;
    while (::fcntl(fd, F_SETLEASE, F_WRLCK) != 0) {
        if (errno != EAGAIN || std::chrono::steady_clock::now() >= giveUp)
            return;
        std::this_thread::sleep_for(std::chrono::milliseconds(1));
    }
    ::fcntl(fd, F_SETLEASE, F_UNLCK);
}
