// SPDX-License-Identifier: MIT
#include "NewFile.h"

#include <cerrno>
#include <charconv>
#include <climits>
#include <csignal>
#include <dirent.h>
#include <fcntl.h>
#include <random>
#include <sys/stat.h>
#include <unistd.h>

#include "FileWrites.h"
#include "QmError.h"

namespace {

// Temporary files that have a name carry the process id, so that a later save can tell the
// leftover of a killed save from a file that another save is still writing.
constexpr std::string_view TemporaryPrefix = ".quillmark-save-";

} // namespace

std::string UniqueNameIn(const std::string& folder, std::string_view prefix)
{
    static thread_local std::mt19937_64 random{std::random_device{}()};
    return folder + "/" + std::string(prefix) + std::to_string(::getpid()) + "-" +
           std::to_string(random() % 1000000007);
}

std::string TemporaryNameIn(const std::string& folder) { return UniqueNameIn(folder, TemporaryPrefix); }

bool ProcessIsGone(long pid)
{
    if (pid <= 0 || pid > INT_MAX)
        return false;
    return ::kill(static_cast<pid_t>(pid), 0) != 0 && errno == ESRCH;
}

bool FolderSweeps::firstVisit(const std::string& folder)
{
    const std::lock_guard lock(mutex_);
    return visited_.insert(folder).second;
}

void RemoveStaleTemporaries(const std::string& folder)
{
    DIR* entries = ::opendir(folder.c_str());
    if (entries == nullptr)
        return;
    while (const auto* entry = ::readdir(entries)) {
        const std::string_view name(entry->d_name);
        if (!name.starts_with(TemporaryPrefix))
            continue;
        const auto pidText = name.substr(TemporaryPrefix.size());
        long pid = 0;
        const auto [end, error] = std::from_chars(pidText.data(), pidText.data() + pidText.size(), pid);
        if (error == std::errc() && *end == '-' && ProcessIsGone(pid))
            ::unlinkat(::dirfd(entries), entry->d_name, 0);
    }
    ::closedir(entries);
}

NewFile::NewFile(const std::string& folder, const std::string& reportedPath)
    : folder_(folder), reportedPath_(reportedPath), fd_(openInFolder())
{
}

NewFile::~NewFile()
{
    if (!temporaryName_.empty())
        ::unlink(temporaryName_.c_str());
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

bool NewFile::linkAs(const std::string& path)
{
    const int result = temporaryName_.empty() ? linkUnnamed(path) : ::link(temporaryName_.c_str(), path.c_str());
    if (result != 0) {
        if (errno == EEXIST)
            return false;
        throw OsError(errno, reportedPath_);
    }
    closeChecked();
    return true;
}

void NewFile::nameAndClose()
{
    if (temporaryName_.empty()) {
        const auto name = TemporaryNameIn(folder_);
        if (linkUnnamed(name) != 0)
            throw OsError(errno, reportedPath_);
        temporaryName_ = name;
    }
    closeChecked();
}

void NewFile::renameTo(const std::string& path)
{
    if (::rename(temporaryName_.c_str(), path.c_str()) != 0)
        throw OsError(errno, path);
    temporaryName_.clear();
}

int NewFile::openInFolder()
{
    const int fd = ::open(folder_.c_str(), O_TMPFILE | O_WRONLY | O_CLOEXEC, 0600);
    if (fd >= 0)
        return fd;
    if (errno != EOPNOTSUPP && errno != EISDIR && errno != EINVAL)
        throw OsError(errno, reportedPath_);
    for (;;) {
        temporaryName_ = TemporaryNameIn(folder_);
        const int named = ::open(temporaryName_.c_str(), O_CREAT | O_EXCL | O_WRONLY | O_CLOEXEC, 0600);
        if (named >= 0)
            return named;
        if (errno != EEXIST)
            throw OsError(errno, reportedPath_);
    }
}

int NewFile::linkUnnamed(const std::string& path) const
{
    const auto self = "/proc/self/fd/" + std::to_string(fd_.get());
    return ::linkat(AT_FDCWD, self.c_str(), AT_FDCWD, path.c_str(), AT_SYMLINK_FOLLOW);
}

void NewFile::closeChecked()
{
    if (::close(fd_.release()) != 0)
        throw OsError(errno, reportedPath_);
}
