// SPDX-License-Identifier: MIT
#pragma once

#include <chrono>
#include <functional>
#include <string>

#include "QmError.h"

class OpenPart;

// How long a save waits for another program that holds the part locked, what it says meanwhile,
// and what ends the wait early.
struct LockWait {
    std::chrono::milliseconds patience{10000};
    std::function<void(const std::string& path)> waiting; // called once, when the part is found locked
    std::function<bool()> interrupted;                    // true: stop waiting now
};

// Another program held the part locked for the whole wait.
class FileLockedError : public QmError {
public:
    explicit FileLockedError(const std::string& path);
};

// The wait for a lock was ended by an interrupt (Ctrl+C, SIGTERM).
class InterruptedError : public QmError {
public:
    InterruptedError();
};

// An advisory lock on an open part, held from construction to destruction, so that two Quillmark
// processes (or threads) never check and replace one file at the same time. It locks the file
// itself, not a lock file beside it, so nothing is left behind when the holder is killed. On a
// file system without locks the part is not locked.
class FileLock {
public:
    FileLock(const OpenPart& part, const LockWait& wait);
    ~FileLock();
    FileLock(const FileLock&) = delete;
    FileLock& operator=(const FileLock&) = delete;
    // Waits, up to patience, until no other process has the part open, as far as the system tells
    // (a write lease can be taken on it): not on file systems without leases, nor for a file of
    // another user.
    void waitUntilOthersClosed(std::chrono::milliseconds patience) const;

private:
    const OpenPart& part_;
    bool locked_ = false;
};
