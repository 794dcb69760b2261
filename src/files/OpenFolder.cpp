// SPDX-License-Identifier: MIT
#include "OpenFolder.h"

#include <cerrno>
#include <fcntl.h>
#include <unistd.h>

#include "QmError.h"

std::shared_ptr<const OpenFolder> OpenFolder::open(const std::string& path, const std::string& forPath)
{
    FileDescriptor fd(::open(path.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    if (!fd.valid())
        throw OsError(errno, forPath.empty() ? path : forPath);
    return std::make_shared<const OpenFolder>(std::move(fd), path);
}

std::shared_ptr<const OpenFolder> OpenFolder::openSubfolder(std::string_view name) const
{
    const auto path = pathOf(name);
    FileDescriptor fd(::openat(fd_.get(), std::string(name).c_str(), O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC));
    if (!fd.valid())
        throw OsError(errno, path);
    return std::make_shared<const OpenFolder>(std::move(fd), path);
}

std::string OpenFolder::pathOf(std::string_view name) const
{
    return (path_.ends_with('/') ? path_ : path_ + "/") + std::string(name);
}

int OpenFolder::whyNoNewFiles() const { return ::faccessat(fd_.get(), ".", W_OK | X_OK, AT_EACCESS) == 0 ? 0 : errno; }

void OpenFolder::sync() const
{
    // Best effort: some file systems cannot sync a folder, and the file itself is in place.
    ::fsync(fd_.get());
}
