// SPDX-License-Identifier: MIT
#pragma once

#include <initializer_list>
#include <mutex>
#include <set>
#include <string>
#include <string_view>
#include <sys/types.h>

#include "FileDescriptor.h"

struct stat;

// A new file in a folder that gets its name only once it is complete: an unnamed O_TMPFILE where
// the file system has them (nothing is left when the program is killed), otherwise a temporary
// name that is removed again unless the file was put in place.
class NewFile {
public:
    NewFile(const std::string& folder, const std::string& reportedPath);
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
    // Gives the complete file the name path; false, with nothing changed, when path exists.
    bool linkAs(const std::string& path);
    // Gives the complete file a temporary name, closes it and returns once before is done, then
    // puts it in the place of path in one rename.
    template <typename Before>
    void replace(const std::string& path, const Before& before)
    {
        nameAndClose();
        before();
        renameTo(path);
    }

private:
    int openInFolder();
    int linkUnnamed(const std::string& path) const;
    void nameAndClose();
    void renameTo(const std::string& path);
    void closeChecked();

    std::string folder_;
    std::string reportedPath_;
    std::string temporaryName_; // set by openInFolder while fd_ is made, so declared before it
    FileDescriptor fd_;
};

// A hidden name in folder that no other process uses: prefix, this process's id, a random number.
std::string UniqueNameIn(const std::string& folder, std::string_view prefix);

// A name for a temporary file in folder, that the next run removes once this process is gone.
std::string TemporaryNameIn(const std::string& folder);

// True when no process with that id runs any more.
bool ProcessIsGone(long pid);

// The folders whose leftover temporary files a run has cleared already: a folder is looked at
// once per run, whatever the number of files saved in it. Shared by threads.
class FolderSweeps {
public:
    // True the first time folder is named.
    bool firstVisit(const std::string& folder);

private:
    std::mutex mutex_;
    std::set<std::string> visited_;
};

// Removes the named temporary files that saves in folder left when they were killed.
void RemoveStaleTemporaries(const std::string& folder);
