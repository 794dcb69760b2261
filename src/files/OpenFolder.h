// SPDX-License-Identifier: MIT
#pragma once

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

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
    bool mayCreateFiles() const { return whyNoNewFiles() == 0; }
    // 0 when this user may create files here, else the system's reason (errno) why not.
    int whyNoNewFiles() const;
    // Flushes the folder's entries, so that a new name in it survives a crash.
    void sync() const;

    // The names of the keep files that a listing of the folder saw (see KeepFile.h); none when the
    // folder was not listed, and a keep file is then looked up by its name.
    const std::optional<std::vector<std::string>>& listedKeepNames() const { return keepNames_; }

    OpenFolder(FileDescriptor fd, std::string path, std::optional<std::vector<std::string>> keepNames = {})
        : fd_(std::move(fd)), path_(std::move(path)), keepNames_(std::move(keepNames))
    {
    }

private:
    FileDescriptor fd_;
    std::string path_;
    std::optional<std::vector<std::string>> keepNames_;
};
