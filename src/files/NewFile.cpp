// SPDX-License-Identifier: MIT
#include "NewFile.h"

#include <cerrno>
#include <dirent.h>
#include <fcntl.h>
#include <random>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include "FileWrites.h"
#include "OpenPart.h"
#include "QmError.h"

namespace {

constexpr std::string_view TemporaryPrefix = ".quillmark-save-";
constexpr std::size_t RandomDigits = 16;

bool isTemporaryName(std::string_view name)
{
    if (!name.starts_with(TemporaryPrefix) || name.size() != TemporaryPrefix.size() + RandomDigits)
        return false;
    return name.substr(TemporaryPrefix.size()).find_first_not_of("0123456789abcdef") == std::string_view::npos;
}

bool before(const struct timespec& a, const struct timespec& b)
{
    return a.tv_sec < b.tv_sec || (a.tv_sec == b.tv_sec && a.tv_nsec < b.tv_nsec);
}

// A leftover of a killed save: this user's regular file whose name it got before the run began,
// and that no save holds locked any more.
bool isLeftover(int folder, const char* name, const struct timespec& runStart)
{
    const FileDescriptor file(::openat(folder, name, O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC | O_NOCTTY));
    struct stat info {};
    return file.valid() && ::fstat(file.get(), &info) == 0 && S_ISREG(info.st_mode) && info.st_uid == ::geteuid() &&
           before(info.st_ctim, runStart) && ::flock(file.get(), LOCK_EX | LOCK_NB) == 0;
}

void removeLeftovers(const OpenFolder& folder, const struct timespec& runStart)
{
    const int listing = ::openat(folder.fd(), ".", O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    DIR* entries = listing < 0 ? nullptr : ::fdopendir(listing);
    if (entries == nullptr) {
        if (listing >= 0)
            ::close(listing);
        return;
    }
    while (const auto* entry = ::readdir(entries))
        if (isTemporaryName(entry->d_name) && isLeftover(folder.fd(), entry->d_name, runStart))
            ::unlinkat(folder.fd(), entry->d_name, 0);
    ::closedir(entries);
}

} // namespace

std::string TemporaryName()
{
    static thread_local std::mt19937_64 random{std::random_device{}()};
    constexpr char Digits[] = "0123456789abcdef";
    std::string name(TemporaryPrefix);
    auto bits = random();
    for (std::size_t i = 0; i < RandomDigits; ++i, bits >>= 4)
        name += Digits[bits & 15];
    return name;
}

FolderSweeps::FolderSweeps() { ::clock_gettime(CLOCK_REALTIME, &start_); }

void FolderSweeps::sweep(const OpenFolder& folder)
{
    struct stat info {};
    if (::fstat(folder.fd(), &info) != 0)
        return;
    {
        const std::lock_guard lock(mutex_);
        if (!visited_.insert({info.st_dev, info.st_ino}).second)
            return;
    }
    removeLeftovers(folder, start_);
}

NewFile::NewFile(const OpenFolder& folder, std::string reportedPath)
    : folder_(folder), reportedPath_(std::move(reportedPath)), fd_(openInFolder())
{
    if (::flock(fd_.get(), LOCK_EX) != 0 && errno != ENOLCK && errno != EOPNOTSUPP)
        throw OsError(errno, reportedPath_);
}

NewFile::~NewFile()
{
    if (!temporaryName_.empty())
        ::unlinkat(folder_.fd(), temporaryName_.c_str(), 0);
}

void NewFile::write(std::initializer_list<std::string_view> pieces)
{
    for (const auto piece : pieces)
        WriteAll(fd_.get(), piece, reportedPath_);
}

bool NewFile::takeOwnerAndModeOf(const struct stat& original)
{
    [[maybe_unused]] const int ignored = ::fchown(fd_.get(), original.st_uid, original.st_gid);
    struct stat now {};
    if (::fstat(fd_.get(), &now) != 0)
        throw OsError(errno, reportedPath_);
    if (now.st_uid != original.st_uid || now.st_gid != original.st_gid)
        return false;
    setMode(original.st_mode & 07777);
    return true;
}

void NewFile::setMode(mode_t mode)
{
    if (::fchmod(fd_.get(), mode) != 0)
        throw OsError(errno, reportedPath_);
}

void NewFile::sync()
{
    if (::fsync(fd_.get()) != 0)
        throw OsError(errno, reportedPath_);
}

bool NewFile::linkAs(std::string_view name)
{
    const std::string wanted(name);
    const int result = temporaryName_.empty()
                           ? linkUnnamed(wanted)
                           : ::linkat(folder_.fd(), temporaryName_.c_str(), folder_.fd(), wanted.c_str(), 0);
    if (result != 0) {
        if (errno == EEXIST)
            return false;
        throw OsError(errno, reportedPath_);
    }
    closeChecked();
    return true;
}

FileDescriptor NewFile::openForReading() const
{
    const int held = fd_.valid() ? fd_.get() : lockHolder_.get();
    return FileDescriptor(::open(DescriptorPath(held).c_str(), O_RDONLY | O_CLOEXEC | O_NOCTTY | O_NONBLOCK));
}

void NewFile::nameAndClose()
{
    if (temporaryName_.empty()) {
        auto name = TemporaryName();
        if (linkUnnamed(name) != 0)
            throw OsError(errno, reportedPath_);
        temporaryName_ = std::move(name);
    }
    closeChecked();
}

void NewFile::renameTo(std::string_view name)
{
    if (::renameat(folder_.fd(), temporaryName_.c_str(), folder_.fd(), std::string(name).c_str()) != 0)
        throw OsError(errno, reportedPath_);
    temporaryName_.clear();
}

int NewFile::openInFolder()
{
    const int fd = ::openat(folder_.fd(), ".", O_TMPFILE | O_WRONLY | O_CLOEXEC, 0600);
    if (fd >= 0)
        return fd;
    if (errno != EOPNOTSUPP && errno != EISDIR && errno != EINVAL)
        throw OsError(errno, reportedPath_);
    for (;;) {
        temporaryName_ = TemporaryName();
        const int named =
            ::openat(folder_.fd(), temporaryName_.c_str(), O_CREAT | O_EXCL | O_WRONLY | O_CLOEXEC | O_NOFOLLOW, 0600);
        if (named >= 0)
            return named;
        if (errno != EEXIST)
            throw OsError(errno, reportedPath_);
    }
}

int NewFile::linkUnnamed(const std::string& name) const
{
    return ::linkat(AT_FDCWD, DescriptorPath(fd_.get()).c_str(), folder_.fd(), name.c_str(), AT_SYMLINK_FOLLOW);
}

void NewFile::closeChecked()
{
    if (!lockHolder_.valid())
        lockHolder_ = FileDescriptor(::dup(fd_.get()));
    if (::close(fd_.release()) != 0)
        throw OsError(errno, reportedPath_);
}
