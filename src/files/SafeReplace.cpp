#include "SafeReplace.h"

#include <cerrno>
#include <charconv>
#include <climits>
#include <csignal>
#include <cstdlib>
#include <fcntl.h>
#include <filesystem>
#include <random>
#include <sys/stat.h>
#include <unistd.h>

#include "FileDescriptor.h"
#include "Folders.h"
#include "PartFile.h"
#include "QmError.h"

namespace {

// Temporary files that have a name carry the process id, so that a later save can tell the
// leftover of a killed save from a file that another save is still writing.
constexpr std::string_view TemporaryPrefix = ".quillmark-save-";
// The copy of a file that is rewritten in place; it outlives a save killed half-way through the
// rewrite, as the one whole copy of the old bytes.
constexpr std::string_view KeepPrefix = ".quillmark-keep-";

std::string uniqueNameIn(const std::string& folder, std::string_view prefix)
{
    static thread_local std::mt19937_64 random{std::random_device{}()};
    return folder + "/" + std::string(prefix) + std::to_string(::getpid()) + "-" +
           std::to_string(random() % 1000000007);
}

void reach(const ReplaceStepHook& afterStep, ReplaceStep step)
{
    if (afterStep)
        afterStep(step);
}

mode_t modeForNewFile()
{
    const mode_t mask = ::umask(0);
    ::umask(mask);
    return 0666 & ~mask;
}

void writeAll(int fd, std::string_view bytes, const std::string& path)
{
    while (!bytes.empty()) {
        const auto written = ::write(fd, bytes.data(), bytes.size());
        if (written < 0) {
            if (errno == EINTR)
                continue;
            throw OsError(errno, path);
        }
        bytes.remove_prefix(static_cast<std::size_t>(written));
    }
}

void syncFolder(const std::string& folder)
{
    const FileDescriptor handle(::open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    // Best effort: some file systems cannot sync a folder, and the file itself is in place.
    if (handle.valid())
        ::fsync(handle.get());
}

void checkWritable(const std::string& path, const struct stat& info)
{
    // A file without any write permission stays as it is, even for root.
    if ((info.st_mode & 0222) == 0)
        throw OsError(EACCES, path);
    if (::faccessat(AT_FDCWD, path.c_str(), W_OK, AT_EACCESS) != 0)
        throw OsError(errno, path);
}

bool processIsGone(std::string_view pidText)
{
    long pid = 0;
    const auto [end, error] = std::from_chars(pidText.data(), pidText.data() + pidText.size(), pid);
    if (error != std::errc() || end != pidText.data() + pidText.size() || pid <= 0 || pid > INT_MAX)
        return false;
    return ::kill(static_cast<pid_t>(pid), 0) != 0 && errno == ESRCH;
}

// Removes the named temporary files of earlier saves in folder that were killed before they could.
void removeStaleTemporaries(const std::string& folder)
{
    std::error_code error;
    for (const auto& entry : std::filesystem::directory_iterator(folder, error)) {
        const auto name = entry.path().filename().string();
        if (name.rfind(TemporaryPrefix, 0) != 0)
            continue;
        const auto pidText = std::string_view(name).substr(TemporaryPrefix.size());
        if (processIsGone(pidText.substr(0, pidText.find('-'))))
            ::unlink(entry.path().c_str());
    }
}

// A new file in a folder that gets its name only once it is complete: an unnamed O_TMPFILE where
// the file system has them (nothing is left when the program is killed), otherwise a temporary
// name that is removed again unless the file was put in place.
class NewFile {
public:
    NewFile(const std::string& folder, const std::string& reportedPath)
        : folder_(folder), reportedPath_(reportedPath), fd_(openInFolder())
    {
    }
    ~NewFile()
    {
        if (!temporaryName_.empty())
            ::unlink(temporaryName_.c_str());
    }
    NewFile(const NewFile&) = delete;
    NewFile& operator=(const NewFile&) = delete;

    void write(std::initializer_list<std::string_view> pieces)
    {
        for (const auto piece : pieces)
            writeAll(fd_.get(), piece, reportedPath_);
    }

    // Gives the new file the permissions and, where the system allows, the owner of the file it
    // stands in for. False when owner or group would differ.
    bool takeOwnerAndModeOf(const struct stat& original)
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
    void setMode(mode_t mode)
    {
        if (::fchmod(fd_.get(), mode) != 0)
            throw OsError(errno, reportedPath_);
    }
    void sync()
    {
        if (::fsync(fd_.get()) != 0)
            throw OsError(errno, reportedPath_);
    }

    // Gives the complete file the name path, which must not exist yet.
    void linkAs(const std::string& path)
    {
        const int result = temporaryName_.empty() ? linkUnnamed(path) : ::link(temporaryName_.c_str(), path.c_str());
        if (result != 0)
            throw OsError(errno, errno == EEXIST ? path : reportedPath_);
        closeChecked();
    }

    // Puts the complete file in the place of path in one rename.
    void replace(const std::string& path, const ReplaceStepHook& afterStep)
    {
        if (temporaryName_.empty()) {
            const auto name = uniqueNameIn(folder_, TemporaryPrefix);
            if (linkUnnamed(name) != 0)
                throw OsError(errno, reportedPath_);
            temporaryName_ = name;
        }
        closeChecked();
        reach(afterStep, ReplaceStep::NewTextNamed);
        if (::rename(temporaryName_.c_str(), path.c_str()) != 0)
            throw OsError(errno, path);
        temporaryName_.clear();
    }

private:
    // Sets temporaryName_ when the file system has no unnamed files.
    int openInFolder()
    {
        const int fd = ::open(folder_.c_str(), O_TMPFILE | O_WRONLY | O_CLOEXEC, 0600);
        if (fd >= 0)
            return fd;
        if (errno != EOPNOTSUPP && errno != EISDIR && errno != EINVAL)
            throw OsError(errno, reportedPath_);
        for (;;) {
            temporaryName_ = uniqueNameIn(folder_, TemporaryPrefix);
            const int named = ::open(temporaryName_.c_str(), O_CREAT | O_EXCL | O_WRONLY | O_CLOEXEC, 0600);
            if (named >= 0)
                return named;
            if (errno != EEXIST)
                throw OsError(errno, reportedPath_);
        }
    }
    int linkUnnamed(const std::string& path) const
    {
        const auto self = "/proc/self/fd/" + std::to_string(fd_.get());
        return ::linkat(AT_FDCWD, self.c_str(), AT_FDCWD, path.c_str(), AT_SYMLINK_FOLLOW);
    }
    void closeChecked()
    {
        if (::close(fd_.release()) != 0)
            throw OsError(errno, reportedPath_);
    }

    std::string folder_;
    std::string reportedPath_;
    std::string temporaryName_; // set by openInFolder while fd_ is made, so declared before it
    FileDescriptor fd_;
};

// A new file at path (which must not exist) holding bytes, on disk, with the mode and, where the
// system allows, the owner of original.
void writeCopy(const std::string& path, std::string_view bytes, const struct stat& original)
{
    NewFile copy(FolderOf(path), path);
    copy.write({bytes});
    if (!copy.takeOwnerAndModeOf(original))
        copy.setMode(original.st_mode & 07777);
    copy.sync();
    copy.linkAs(path);
}

// Removes the file at path unless it was kept.
class Undo {
public:
    explicit Undo(std::string path = {}) : path_(std::move(path)) {}
    ~Undo()
    {
        if (!path_.empty())
            ::unlink(path_.c_str());
    }
    Undo(const Undo&) = delete;
    Undo& operator=(const Undo&) = delete;
    void keep() { path_.clear(); }

private:
    std::string path_;
};

// The old file under the backup name: a second name for it where the file system allows,
// otherwise a copy of its bytes.
void makeBackup(const std::string& target, const std::string& backupPath, const struct stat* original)
{
    if (original == nullptr)
        throw OsError(ENOENT, target); // nothing to back up
    if (::link(target.c_str(), backupPath.c_str()) == 0)
        return;
    const int linkError = errno;
    if (linkError != EPERM && linkError != EXDEV && linkError != EMLINK && linkError != ENOTSUP)
        throw OsError(linkError, linkError == EEXIST ? backupPath : target);
    const FileBytes old(target);
    writeCopy(backupPath, old.view(), *original);
}

void overwrite(const std::string& target, std::initializer_list<std::string_view> pieces)
{
    const FileDescriptor file(::open(target.c_str(), O_WRONLY | O_CLOEXEC | O_NOCTTY));
    if (!file.valid())
        throw OsError(errno, target);
    std::size_t size = 0;
    for (const auto piece : pieces) {
        writeAll(file.get(), piece, target);
        size += piece.size();
    }
    if (::ftruncate(file.get(), static_cast<off_t>(size)) != 0 || ::fsync(file.get()) != 0)
        throw OsError(errno, target);
}

// For a file that must keep its inode (several hard links, an owner a new file could not have):
// its old bytes are first made safe in a copy (the backup, or a hidden copy removed afterwards),
// then it is rewritten, and written back from the copy if that fails.
void rewriteInPlace(const std::string& target, const struct stat& original,
                    std::initializer_list<std::string_view> pieces, const std::optional<std::string>& backupPath,
                    const ReplaceStepHook& afterStep, const std::string& copyFolder)
{
    const FileBytes old(target);
    const auto copyPath = backupPath ? *backupPath : uniqueNameIn(copyFolder, KeepPrefix);
    writeCopy(copyPath, old.view(), original);
    Undo copy(copyPath);
    reach(afterStep, ReplaceStep::BackupMade);
    try {
        overwrite(target, pieces);
    } catch (const QmError&) {
        try {
            overwrite(target, {old.view()});
        } catch (const QmError&) {
            copy.keep(); // the copy is now the one whole version of the old bytes
        }
        throw;
    }
    if (backupPath)
        copy.keep();
    reach(afterStep, ReplaceStep::Placed);
}

// The usual road: the new file takes the old one's name in one rename. False, with nothing
// changed, when the new file could not keep the old one's owner.
bool replaceByRename(const std::string& target, const struct stat* original,
                     std::initializer_list<std::string_view> pieces, const std::optional<std::string>& backupPath,
                     const ReplaceStepHook& afterStep)
{
    NewFile file(FolderOf(target), target);
    file.write(pieces);
    if (original == nullptr)
        file.setMode(modeForNewFile());
    else if (!file.takeOwnerAndModeOf(*original))
        return false;
    file.sync();
    reach(afterStep, ReplaceStep::NewTextWritten);
    std::optional<Undo> backup;
    if (backupPath) {
        makeBackup(target, *backupPath, original);
        backup.emplace(*backupPath);
    }
    reach(afterStep, ReplaceStep::BackupMade);
    file.replace(target, afterStep);
    if (backup)
        backup->keep();
    reach(afterStep, ReplaceStep::Placed);
    return true;
}

// "models/../real.dat" as "/home/ann/real.dat", so that the backup's name reads plainly.
std::string withCanonicalFolder(const std::string& path)
{
    char* folder = ::realpath(FolderOf(path).c_str(), nullptr);
    if (folder == nullptr)
        return path;
    std::string canonical(folder);
    std::free(folder);
    return (canonical == "/" ? "" : canonical) + "/" + path.substr(path.rfind('/') + 1);
}

} // namespace

std::string ResolveLinks(const std::string& path)
{
    std::string resolved = path;
    for (int hops = 0; hops < 40; ++hops) {
        struct stat info {};
        if (::lstat(resolved.c_str(), &info) != 0 || !S_ISLNK(info.st_mode))
            return hops == 0 ? resolved : withCanonicalFolder(resolved);
        std::string target(PATH_MAX, '\0');
        const auto length = ::readlink(resolved.c_str(), target.data(), target.size());
        if (length < 0)
            return resolved;
        target.resize(static_cast<std::size_t>(length));
        if (target.empty() || target.front() != '/')
            target.insert(0, resolved.substr(0, resolved.rfind('/') + 1));
        resolved = std::move(target);
    }
    throw OsError(ELOOP, path);
}

void ReplaceFileSafely(const std::string& path, std::initializer_list<std::string_view> pieces,
                       const std::optional<std::string>& backupPath, const ReplaceStepHook& afterStep)
{
    const auto target = ResolveLinks(path);
    struct stat original {};
    const bool exists = ::stat(target.c_str(), &original) == 0;
    if (exists)
        checkWritable(target, original);
    const auto folder = FolderOf(target);
    removeStaleTemporaries(folder);
    // A file this user may write in a folder where he may not create files can only be rewritten
    // in place, with the copy of its old bytes in the temporary folder.
    const bool folderWritable = ::faccessat(AT_FDCWD, folder.c_str(), W_OK | X_OK, AT_EACCESS) == 0;
    const auto copyFolder = folderWritable ? folder : std::filesystem::temp_directory_path().string();
    const bool keepInode = exists && (original.st_nlink > 1 || (!folderWritable && !backupPath));
    if (keepInode || !replaceByRename(target, exists ? &original : nullptr, pieces, backupPath, afterStep))
        rewriteInPlace(target, original, pieces, backupPath, afterStep, copyFolder);
    syncFolder(folder);
}
