// SPDX-License-Identifier: MIT
#pragma once

#include <chrono>
#include <string>

#include "FileDescriptor.h"

// An advisory lock on an existing file, held from construction to destruction, so that two
// Quillmark processes (or threads) never check and replace one file at the same time. It locks
// the file itself, not a lock file beside it, so nothing is left behind when the holder is killed.
// When another process put a new file in the place of the locked one meanwhile, the new one is
// locked instead. A file that does not exist or cannot be opened is not locked.
class FileLock {
public:
    explicit FileLock(const std::string& path);
    // The locked file, open for reading; -1 when none is locked.
    int fd() const { return fd_.get(); }
    // Waits, up to patience, until no other process has the locked file open, as far as the system
    // tells (a write lease can be taken on it): not on file systems without leases, nor for a file
    // of another user.
    void waitUntilOthersClosed(std::chrono::milliseconds patience) const;

private:
    FileDescriptor fd_;
};
