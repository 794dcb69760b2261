// SPDX-License-Identifier: MIT
#pragma once

#include <atomic>
#include <cstdint>
#include <memory>
#include <string>
#include <sys/stat.h>

#include "FileDescriptor.h"
#include "FileStamp.h"
#include "OpenFolder.h"

// What tells one file from another that later gets the same device and inode number: its birth
// time where the file system keeps one.
struct FileIdentity {
    std::uint64_t device = 0;
    std::uint64_t inode = 0;
    std::int64_t bornSeconds = 0;
    std::uint32_t bornNanoseconds = 0;
    bool operator==(const FileIdentity&) const = default;
};

// A regular file opened once, by its name in an open folder, with no link followed at that name.
// Every later step (status, read, compare, lock, rewrite, restore) works on its descriptor, so no
// step can be turned to another file by a name that changes meanwhile.
class OpenPart {
public:
    // The file at path. The links at the end of path are followed first, so that saving through a
    // link writes the file it points to; then its folder and the file in it are opened. Anything
    // but a regular file is refused before a byte is read. Throws QmError.
    static std::shared_ptr<OpenPart> openPath(const std::string& path);
    // The file name in folder, shown in messages as shownPath. Throws QmError.
    static std::shared_ptr<OpenPart> openIn(std::shared_ptr<const OpenFolder> folder, std::string name,
                                            std::string shownPath);

    int fd() const { return fd_.get(); }
    const OpenFolder& folder() const { return *folder_; }
    const std::shared_ptr<const OpenFolder>& sharedFolder() const { return folder_; }
    const std::string& name() const { return name_; }
    // How messages name the file: the path it was opened by, its links followed.
    const std::string& path() const { return path_; }

    // The file's status now.
    struct stat status() const;
    FileStamp stamp() const;
    FileIdentity identity() const;
    // True while the folder's entry of that name is still this file.
    bool stillNamed() const;
    // True when the file is as stamped and still has its name.
    bool unchangedSince(const FileStamp& stamp) const { return this->stamp() == stamp && stillNamed(); }
    // The same file opened again for writing, found through this descriptor, never by name.
    FileDescriptor openForWriting() const;
    // 0 when this user may write the file, else the system's reason (errno) why not. A file
    // without any write permission is denied even to root.
    int whyNotWritable() const;

    // Said by the restore of an interrupted save, which looked at the part's keep file under its
    // lock, and taken by the next save, which then need not look again.
    void markKeepExamined() const { keepExamined_ = true; }
    bool takeKeepExamined() const { return keepExamined_.exchange(false); }

    OpenPart(std::shared_ptr<const OpenFolder> folder, std::string name, std::string path, FileDescriptor fd)
        : folder_(std::move(folder)), name_(std::move(name)), path_(std::move(path)), fd_(std::move(fd))
    {
    }

private:
    std::shared_ptr<const OpenFolder> folder_;
    std::string name_;
    std::string path_;
    FileDescriptor fd_;
    mutable std::atomic<bool> keepExamined_ = false;
};

// The path by which the system reaches the open file fd itself, whatever its names are now.
std::string DescriptorPath(int fd);
