// SPDX-License-Identifier: MIT
#pragma once

#include <memory>
#include <string>
#include <string_view>

#include "FileDescriptor.h"

// A folder held open: files are found, made, linked, renamed and removed in it through its
// descriptor, so that another user who renames the folder or puts a link in its place between
// two steps cannot make a step act on another folder.
class OpenFolder {
public:
    // The folder at path, following links on the way as the user named it; throws QmError, which
    // names forPath (the file sought there) when given.
    static std::shared_ptr<const OpenFolder> open(const std::string& path, const std::string& forPath = {});
    // Its subfolder name, which must be no link; throws QmError.
    std::shared_ptr<const OpenFolder> openSubfolder(std::string_view name) const;

    int fd() const { return fd_.get(); }
    // How messages name the folder.
    const std::string& path() const { return path_; }
    // How messages name the entry name of this folder.
    std::string pathOf(std::string_view name) const;
    // True when this user may create files here.
    bool mayCreateFiles() const;
    // Flushes the folder's entries, so that a new name in it survives a crash.
    void sync() const;

    OpenFolder(FileDescriptor fd, std::string path) : fd_(std::move(fd)), path_(std::move(path)) {}

private:
    FileDescriptor fd_;
    std::string path_;
};
