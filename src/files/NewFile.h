// SPDX-License-Identifier: MIT
#pragma once

#include <ctime>
#include <initializer_list>
#include <mutex>
#include <set>
#include <string>
#include <string_view>
#include <sys/types.h>
#include <utility>

#include "FileDescriptor.h"
#include "OpenFolder.h"

struct stat;

// A new file in an open folder that gets its name only once it is complete: an unnamed O_TMPFILE
// where the file system has them (nothing is left when the program is killed), otherwise a
// temporary name that is removed again unless the file was put in place. It holds a lock from
// its first byte until it has its final name, so that no sweep takes it for a leftover.
class NewFile {
public:
    NewFile(const OpenFolder& folder, std::string reportedPath);
    ~NewFile();
    NewFile(const NewFile&) = delete;
    NewFile& operator=(const NewFile&) = delete;

    int fd() const { return fd_.get(); }
    void write(std::initializer_list<std::string_view> pieces);
    // Gives the new file the permissions and, where the system allows, the owner of the file it
    // stands in for. False when owner or group would differ.
    bool takeOwnerAndModeOf(const struct stat& original);
    void setMode(mode_t mode);
    void sync();
    // Gives the complete file the name in the folder; false, with nothing changed, when the name
    // is taken. The file stays locked until this object goes.
    bool linkAs(std::string_view name);
    // Gives the complete file a temporary name, closes it and returns once before is done, then
    // puts it in the place of name in one rename.
    template <typename Before>
    void replace(std::string_view name, const Before& before)
    {
        nameAndClose();
        before();
        renameTo(name);
    }
    // The file open for reading, also after linkAs or replace; invalid when this user may not read it.
    FileDescriptor openForReading() const;

private:
    int openInFolder();
    int linkUnnamed(const std::string& name) const;
    void nameAndClose();
    void renameTo(std::string_view name);
    void closeChecked();

    const OpenFolder& folder_;
    std::string reportedPath_;
    std::string temporaryName_; // set by openInFolder while fd_ is made, so declared before it
    FileDescriptor fd_;
    FileDescriptor lockHolder_; // the same open file: its lock outlives the checked close of fd_
};

// A hidden name for a temporary file: a fixed prefix and 16 random hexadecimal digits, a form
// nobody else chooses, so that a sweep can tell this program's leftovers from a user's files.
std::string TemporaryName();

// The folders whose leftover temporary files a run has cleared already: a folder is looked at
// once per run, whatever the number of files saved in it. Shared by threads. Only leftovers
// older than the run are removed.
class FolderSweeps {
public:
    FolderSweeps();
    // Removes what killed saves left in folder, the first time the folder is named.
    void sweep(const OpenFolder& folder);

private:
    std::mutex mutex_;
    std::set<std::pair<dev_t, ino_t>> visited_;
    struct timespec start_;
};
