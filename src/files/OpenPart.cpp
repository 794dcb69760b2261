// SPDX-License-Identifier: MIT
#include "OpenPart.h"

#include <cerrno>
#include <fcntl.h>
#include <sys/sysmacros.h>
#include <unistd.h>

#include "Folders.h"
#include "QmError.h"
#include "SafeReplace.h"

std::shared_ptr<OpenPart> OpenPart::openPath(const std::string& path)
{
    const auto target = ResolveLinks(path);
    const auto slash = target.rfind('/');
    return openIn(OpenFolder::open(FolderOf(target), target), target.substr(slash == std::string::npos ? 0 : slash + 1),
                  target);
}

std::shared_ptr<OpenPart> OpenPart::openIn(std::shared_ptr<const OpenFolder> folder, std::string name,
                                           std::string shownPath)
{
    // Without O_NONBLOCK, opening a FIFO would wait for a writer that may never come.
    FileDescriptor fd(::openat(folder->fd(), name.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK | O_NOCTTY | O_NOFOLLOW));
    if (!fd.valid())
        throw OsError(errno, shownPath); // ELOOP: a link put in the file's place
    struct stat info {};
    if (::fstat(fd.get(), &info) != 0)
        throw OsError(errno, shownPath);
    if (!S_ISREG(info.st_mode))
        throw NoRegularFileError(shownPath, S_ISDIR(info.st_mode));
    return std::make_shared<OpenPart>(std::move(folder), std::move(name), std::move(shownPath), std::move(fd));
}

struct stat OpenPart::status() const
{
    struct stat info {};
    if (::fstat(fd_.get(), &info) != 0)
        throw OsError(errno, path_);
    return info;
}

FileStamp OpenPart::stamp() const { return StampOf(status()); }

FileIdentity OpenPart::identity() const
{
    struct statx info {};
    if (::statx(fd_.get(), "", AT_EMPTY_PATH, STATX_INO | STATX_BTIME, &info) != 0)
        throw OsError(errno, path_);
    FileIdentity identity{makedev(info.stx_dev_major, info.stx_dev_minor), info.stx_ino, 0, 0};
    if ((info.stx_mask & STATX_BTIME) != 0) {
        identity.bornSeconds = info.stx_btime.tv_sec;
        identity.bornNanoseconds = info.stx_btime.tv_nsec;
    }
    return identity;
}

bool OpenPart::stillNamed() const
{
    struct stat named {};
    const auto own = status();
    return ::fstatat(folder_->fd(), name_.c_str(), &named, AT_SYMLINK_NOFOLLOW) == 0 && named.st_dev == own.st_dev &&
           named.st_ino == own.st_ino;
}

FileDescriptor OpenPart::openForWriting() const
{
    FileDescriptor fd(::open(DescriptorPath(fd_.get()).c_str(), O_WRONLY | O_CLOEXEC | O_NOCTTY | O_NONBLOCK));
    if (!fd.valid())
        throw OsError(errno, path_);
    return fd;
}

int OpenPart::whyNotWritable() const
{
    if ((status().st_mode & 0222) == 0)
        return EACCES;
    return ::faccessat(AT_FDCWD, DescriptorPath(fd_.get()).c_str(), W_OK, AT_EACCESS) == 0 ? 0 : errno;
}

std::string DescriptorPath(int fd) { return "/proc/self/fd/" + std::to_string(fd); }
