// SPDX-License-Identifier: MIT
#include "SafeReplace.h"

#include <cerrno>
#include <climits>
#include <cstdlib>
#include <dirent.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include "Attributes.h"
#include "FileLock.h"
#include "FileWrites.h"
#include "Folders.h"
#include "KeepFile.h"
#include "NewFile.h"
#include "PartFile.h"

namespace {

// A backup name is tried with these numbers before the save gives up.
constexpr int MostBackupNumbers = 1000;
// How long a save waits for another program that has the old file open to close it.
constexpr std::chrono::milliseconds PatienceWithWriters{100};

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

void checkWritable(const std::string& path, const struct stat& info)
{
    // A file without any write permission stays as it is, even for root.
    if ((info.st_mode & 0222) == 0)
        throw OsError(EACCES, path);
    if (::faccessat(AT_FDCWD, path.c_str(), W_OK, AT_EACCESS) != 0)
        throw OsError(errno, path);
}

// "a_Backup.dat", "a_Backup (2).dat", "a_Backup (3).dat"...
std::string numberedName(const std::string& path, int number)
{
    if (number == 1)
        return path;
    const auto nameStart = path.rfind('/') + 1; // 0 without a folder
    const auto dot = path.find('.', nameStart + 1);
    const auto at = dot == std::string::npos ? path.size() : dot;
    return path.substr(0, at) + " (" + std::to_string(number) + ")" + path.substr(at);
}

// Tries makeAs with each numbered form of path until one is free; returns the name it took.
template <typename MakeAs>
std::string firstFreeName(const std::string& path, const MakeAs& makeAs)
{
    for (int number = 1; number <= MostBackupNumbers; ++number) {
        auto name = numberedName(path, number);
        if (makeAs(name))
            return name;
    }
    throw OsError(EEXIST, path);
}

// A new file at the first free form of path holding bytes, on disk, with the mode and, where the
// system allows, the owner of original. Returns its name.
std::string writeCopy(const std::string& path, std::string_view bytes, const struct stat& original)
{
    NewFile copy(FolderOf(path), path);
    copy.write({bytes});
    if (!copy.takeOwnerAndModeOf(original))
        copy.setMode(original.st_mode & 07777);
    copy.sync();
    return firstFreeName(path, [&copy](const std::string& name) { return copy.linkAs(name); });
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
// otherwise a copy of its bytes. Returns the name it took.
std::string makeBackup(const std::string& target, const std::string& backupPath, const struct stat& original)
{
    int linkError = 0;
    const auto linked = firstFreeName(backupPath, [&](const std::string& name) {
        linkError = ::link(target.c_str(), name.c_str()) == 0 ? 0 : errno;
        return linkError != EEXIST;
    });
    if (linkError == 0)
        return linked;
    if (linkError != EPERM && linkError != EXDEV && linkError != EMLINK && linkError != ENOTSUP)
        throw OsError(linkError, target);
    const FileBytes old(target);
    return writeCopy(backupPath, old.view(), original);
}

struct stat statOf(const std::string& path)
{
    struct stat info {};
    ::stat(path.c_str(), &info);
    return info;
}

// The last look before the new text takes the file's name.
void ensureUnchanged(const std::string& target, const FileStamp& expected)
{
    if (StampOfPath(target) != expected)
        throw FileChangedError(target);
}

// The old file keeps a name until the new one is in place and checked: its backup, or else a
// temporary second name. Empty where the file system has no second names.
std::string keepAName(const std::string& target, const std::string& backupPath)
{
    if (!backupPath.empty() && statOf(backupPath).st_ino == statOf(target).st_ino)
        return backupPath;
    auto name = TemporaryNameIn(FolderOf(target));
    return ::link(target.c_str(), name.c_str()) == 0 ? name : std::string();
}

bool stillAsRead(int fd, const FileStamp& expected)
{
    struct stat now {};
    return ::fstat(fd, &now) == 0 && StampOf(now) == expected;
}

// What every road needs to know about the replace it does.
struct Replace {
    const std::string& target;
    const struct stat& original;
    bool exists;
    std::initializer_list<std::string_view> pieces;
    const ReplaceOptions& options;
    FileStamp expected;
    const FileLock& lock; // on the old file
};

// For a file that must keep its inode (several hard links, an owner or attributes a new file
// could not have): its old bytes are first made safe in a keep file, then it is rewritten, and
// written back from the copy if that fails.
ReplaceResult rewriteInPlace(const Replace& r)
{
    const FileBytes old(r.target);
    ReplaceResult result;
    Undo keep(WriteKeepFile(KeepFolderFor(FolderOf(r.target)), r.original, old.view(), FingerprintOf(r.pieces)));
    if (r.options.backupPath)
        result.backupPath = writeCopy(*r.options.backupPath, old.view(), r.original);
    Undo backup(result.backupPath);
    reach(r.options.afterStep, ReplaceStep::BackupMade);
    ensureUnchanged(r.target, r.expected);
    try {
        OverwriteFile(r.target, r.pieces);
    } catch (const QmError&) {
        try {
            OverwriteFile(r.target, {old.view()});
        } catch (const QmError&) {
            keep.keep(); // the one whole version of the old bytes, for the next open to restore
        }
        throw;
    }
    backup.keep();
    reach(r.options.afterStep, ReplaceStep::Placed);
    return result;
}

// The usual road: the new file takes the old one's name in one rename. Nullopt, with nothing
// changed, when the new file could not keep the old one's owner or attributes.
std::optional<ReplaceResult> replaceByRename(const Replace& r)
{
    NewFile file(FolderOf(r.target), r.target);
    file.write(r.pieces);
    if (!r.exists)
        file.setMode(modeForNewFile());
    else if (!file.takeOwnerAndModeOf(r.original) || !TakeAttributesOf(r.target, file.fd()))
        return std::nullopt;
    file.sync();
    reach(r.options.afterStep, ReplaceStep::NewTextWritten);
    // The backup is a second name for the old file, made before the new file takes the part's
    // name: the part's name is never empty, and the backup never holds anything but the old
    // bytes. Killed between the two, the part and its backup are one file with two names; the
    // next save knows that backup by its name and replaces the part by rename again
    // (onlyOtherNameIsABackup), so no save ever writes into a backup.
    ReplaceResult result;
    if (r.options.backupPath)
        result.backupPath = makeBackup(r.target, *r.options.backupPath, r.original);
    Undo backup(result.backupPath);
    const auto oldName = r.exists ? keepAName(r.target, result.backupPath) : std::string();
    Undo temporaryOldName(oldName == result.backupPath ? std::string() : oldName);
    reach(r.options.afterStep, ReplaceStep::BackupMade);
    file.replace(r.target, [&] {
        ensureUnchanged(r.target, r.expected);
        reach(r.options.afterStep, ReplaceStep::NewTextNamed);
    });
    SyncFolder(FolderOf(r.target));
    // Another program that opened the old file before the rename may have written to it since the
    // last look: once it has closed the file (or after a short wait), the old file, with that write,
    // takes its name back.
    if (!oldName.empty() && r.lock.fd() >= 0) {
        r.lock.waitUntilOthersClosed(PatienceWithWriters);
        if (!stillAsRead(r.lock.fd(), r.expected)) {
            ::rename(oldName.c_str(), r.target.c_str());
            SyncFolder(FolderOf(r.target));
            throw FileChangedError(r.target);
        }
    }
    backup.keep();
    reach(r.options.afterStep, ReplaceStep::Placed);
    return result;
}

// True when the file has two names and the other one is one of its own backups.
bool onlyOtherNameIsABackup(const std::string& target, const struct stat& original, const ReplaceOptions& options)
{
    if (original.st_nlink != 2 || !options.isBackupName)
        return false;
    DIR* entries = ::opendir(FolderOf(target).c_str());
    if (entries == nullptr)
        return false;
    bool found = false;
    while (const auto* entry = ::readdir(entries)) {
        struct stat info {};
        if (options.isBackupName(entry->d_name) &&
            ::fstatat(::dirfd(entries), entry->d_name, &info, AT_SYMLINK_NOFOLLOW) == 0 &&
            info.st_ino == original.st_ino && info.st_dev == original.st_dev) {
            found = true;
            break;
        }
    }
    ::closedir(entries);
    return found;
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

void sweep(const std::string& folder, FolderSweeps* sweeps)
{
    if (sweeps == nullptr || sweeps->firstVisit(folder))
        RemoveStaleTemporaries(folder);
}

} // namespace

FileChangedError::FileChangedError(const std::string& path) : QmError(PathFileAccessError()), path_(path) {}

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

ReplaceResult ReplaceFileSafely(const std::string& path, std::initializer_list<std::string_view> pieces,
                                const ReplaceOptions& options)
{
    const auto target = ResolveLinks(path);
    const auto folder = FolderOf(target);
    sweep(folder, options.sweeps);
    const FileLock lock(target);
    RestoreInterruptedRewrite(target);
    struct stat original {};
    const bool exists = ::stat(target.c_str(), &original) == 0;
    const auto expected = options.expected.value_or(exists ? StampOf(original) : FileStamp{});
    const Replace replace{target, original, exists, pieces, options, expected, lock};
    ensureUnchanged(target, expected);
    if (exists)
        checkWritable(target, original);
    // A file this user may write in a folder where he may not create files can only be rewritten
    // in place, with the copy of its old bytes in the temporary folder.
    const bool folderWritable = ::faccessat(AT_FDCWD, folder.c_str(), W_OK | X_OK, AT_EACCESS) == 0;
    const bool hardLinked = original.st_nlink > 1 && !onlyOtherNameIsABackup(target, original, options);
    const bool keepInode = exists && (hardLinked || (!folderWritable && !options.backupPath));
    std::optional<ReplaceResult> result;
    if (!keepInode)
        result = replaceByRename(replace);
    if (!result) {
        result = rewriteInPlace(replace);
        SyncFolder(folder);
    }
    return *result;
}

bool RestoreInterruptedSave(const std::string& path, FolderSweeps* sweeps)
{
    const auto target = ResolveLinks(path);
    sweep(FolderOf(target), sweeps);
    if (!HasKeepFile(target))
        return false; // the usual case, found without taking the lock
    const FileLock lock(target);
    return RestoreInterruptedRewrite(target);
}
