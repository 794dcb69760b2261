// SPDX-License-Identifier: MIT
#include "SafeReplace.h"

#include <algorithm>
#include <cerrno>
#include <climits>
#include <cstdlib>
#include <dirent.h>
#include <fcntl.h>
#include <span>
#include <sys/stat.h>
#include <unistd.h>

#include "Attributes.h"
#include "FileWrites.h"
#include "Folders.h"
#include "NewFile.h"
#include "PartFile.h"
#include "SameBytes.h"

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

std::string fileNameOf(const std::string& path) { return path.substr(path.rfind('/') + 1); }

void checkWritable(const OpenPart& part, const struct stat& info)
{
    // A file without any write permission stays as it is, even for root.
    if ((info.st_mode & 0222) == 0)
        throw OsError(EACCES, part.path());
    if (const int why = part.whyNotWritable())
        throw OsError(why, part.path());
}

// What make returns, a failure of the system said as the backup's: "cannot make the backup
// <path>: permission denied".
template <typename Make>
auto backupSaying(const std::string& backupPath, const Make& make)
{
    try {
        return make();
    } catch (const QmError& error) {
        if (error.systemError() == 0)
            throw;
        throw BackupNotMadeError(backupPath, error.systemError());
    }
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

// Tries makeAs with the file name of each numbered form of path until one is free; returns the
// numbered path it took.
template <typename MakeAs>
std::string firstFreeName(const std::string& path, const MakeAs& makeAs)
{
    for (int number = 1; number <= MostBackupNumbers; ++number) {
        auto name = numberedName(path, number);
        if (makeAs(fileNameOf(name)))
            return name;
    }
    throw OsError(EEXIST, path);
}

// A new file in folder at the first free form of path holding bytes, on disk, with the mode and,
// where the system allows, the owner of original. Returns its path.
std::string writeCopy(const OpenFolder& folder, const std::string& path, std::string_view bytes,
                      const struct stat& original)
{
    NewFile copy(folder, path);
    copy.write({bytes});
    if (!copy.takeOwnerAndModeOf(original))
        copy.setMode(original.st_mode & 07777);
    copy.sync();
    return firstFreeName(path, [&copy](const std::string& name) { return copy.linkAs(name); });
}

// Removes a name in a folder unless it was kept.
class Undo {
public:
    Undo(const OpenFolder& folder, std::string path) : folder_(folder), name_(path.empty() ? "" : fileNameOf(path)) {}
    ~Undo()
    {
        if (!name_.empty())
            ::unlinkat(folder_.fd(), name_.c_str(), 0);
    }
    Undo(const Undo&) = delete;
    Undo& operator=(const Undo&) = delete;
    void keep() { name_.clear(); }

private:
    const OpenFolder& folder_;
    std::string name_;
};

// A second name in the part's folder for the open part itself, whatever its name stands for
// now; the link's errno, 0 when made.
int linkPartAs(const OpenPart& part, const std::string& name)
{
    const int made =
        ::linkat(AT_FDCWD, DescriptorPath(part.fd()).c_str(), part.folder().fd(), name.c_str(), AT_SYMLINK_FOLLOW);
    return made == 0 ? 0 : errno;
}

struct Backup {
    std::string path;
    bool secondName = false; // a second name of the old file, not a copy
};

// The old file under the backup name: a second name for it where the file system allows,
// otherwise a copy of its bytes.
Backup makeBackup(const OpenPart& part, const std::string& backupPath, const struct stat& original)
{
    int linkError = 0;
    const auto linked = firstFreeName(backupPath, [&](const std::string& name) {
        linkError = linkPartAs(part, name);
        return linkError != EEXIST;
    });
    if (linkError == 0)
        return {linked, true};
    if (linkError != EPERM && linkError != EXDEV && linkError != EMLINK && linkError != ENOTSUP)
        throw OsError(linkError, part.path());
    const FileBytes old(part);
    return {writeCopy(part.folder(), backupPath, old.view(), original), false};
}

// The last look before the new text takes the file's name: the name still stands for the file
// read, and the file is as it was read.
void ensureUnchanged(const OpenPart& part, const FileStamp& expected)
{
    if (part.stamp() != expected || !part.stillNamed())
        throw FileChangedError(part.path());
}

// The old file keeps a name until the new one is in place and checked: its backup, or else a
// temporary second name. Empty where the file system has no second names.
std::string keepAName(const OpenPart& part, const Backup& backup)
{
    if (backup.secondName)
        return fileNameOf(backup.path);
    auto name = TemporaryName();
    return linkPartAs(part, name) == 0 ? name : std::string();
}

// What every road needs to know about the replace it does.
struct Replace {
    const std::shared_ptr<OpenPart>& part;
    const struct stat& original;
    std::initializer_list<std::string_view> pieces;
    const ReplaceOptions& options;
    FileStamp expected;
    const FileLock& lock;
};

// What another program's write to a file changes: its size, and its change time unless the write
// falls in the same tick of the clock as the last look.
bool sameLook(const struct stat& now, const struct stat& before)
{
    return now.st_size == before.st_size && now.st_ctim.tv_sec == before.st_ctim.tv_sec &&
           now.st_ctim.tv_nsec == before.st_ctim.tv_nsec;
}

// Writes the pieces over the part through writable, watching for another program's write: after
// the last write the file must have the size the writes give it and keep its look until it is cut
// to length, and then hold exactly the pieces. False when it did not. No check can see a write
// that lands between a look and the next write of ours and is then overwritten: without
// mandatory locks (POSIX has none) only the other program's own lock would keep it out.
bool overwriteWatched(const Replace& r, int writable, std::size_t oldSize)
{
    const auto& part = *r.part;
    const auto size = WriteFromStart(writable, r.pieces, part.path());
    const auto written = part.status();
    reach(r.options.afterStep, ReplaceStep::WrittenInPlace);
    if (static_cast<std::size_t>(written.st_size) != std::max(oldSize, size) || !sameLook(part.status(), written))
        return false;
    CutAndFlush(writable, size, part.path());
    return FileHoldsExactly(part.fd(), std::span(r.pieces.begin(), r.pieces.size()));
}

// For a file that must keep its inode (several hard links, an owner or attributes a new file
// could not have): its old bytes are first made safe in a keep file, then it is rewritten through
// its own descriptor, and written back from the copy if that fails or another program wrote to
// it meanwhile.
ReplaceResult rewriteInPlace(const Replace& r)
{
    const auto& part = *r.part;
    const FileBytes old(part);
    ReplaceResult result;
    KeepFile keep(part, old.view(), r.pieces, r.options.home);
    if (r.options.backupPath)
        result.backupPath = backupSaying(*r.options.backupPath, [&] {
            return writeCopy(part.folder(), *r.options.backupPath, old.view(), r.original);
        });
    Undo backup(part.folder(), result.backupPath);
    reach(r.options.afterStep, ReplaceStep::BackupMade);
    ensureUnchanged(part, r.expected);
    // The last look before the first byte is written.
    if (!sameLook(part.status(), r.original))
        throw FileChangedError(part.path());
    const auto writable = part.openForWriting();
    const auto putOldBytesBack = [&] {
        try {
            OverwriteFile(writable.get(), {old.view()}, part.path());
        } catch (const QmError&) {
            keep.keep(); // the one whole version of the old bytes, for the next open to restore
        }
    };
    bool steady = false;
    try {
        steady = overwriteWatched(r, writable.get(), old.view().size());
    } catch (const QmError&) {
        putOldBytesBack();
        throw;
    }
    if (!steady) {
        const FileBytes stood(part);
        const auto& keepFolder = keep.folder();
        const auto copy =
            writeCopy(keepFolder, keepFolder.pathOf(part.name() + ".changed-while-saving"), stood.view(), r.original);
        putOldBytesBack();
        throw ChangedWhileSavingError(part.path(), copy);
    }
    backup.keep();
    result.written = r.part;
    reach(r.options.afterStep, ReplaceStep::Placed);
    return result;
}

// The part as the new file that took its name, open for reading; null when this user may not
// read it.
std::shared_ptr<OpenPart> writtenPart(const OpenPart& part, const NewFile& file)
{
    auto fd = file.openForReading();
    if (!fd.valid())
        return nullptr;
    return std::make_shared<OpenPart>(part.sharedFolder(), part.name(), part.path(), std::move(fd));
}

// The usual road: the new file takes the old one's name in one rename. Nullopt, with nothing
// changed, when the new file could not keep the old one's owner or attributes.
std::optional<ReplaceResult> replaceByRename(const Replace& r)
{
    const auto& part = *r.part;
    const auto& folder = part.folder();
    NewFile file(folder, part.path());
    file.write(r.pieces);
    if (!file.takeOwnerAndModeOf(r.original) || !TakeAttributesOf(part.fd(), file.fd()))
        return std::nullopt;
    file.sync();
    reach(r.options.afterStep, ReplaceStep::NewTextWritten);
    // The backup is a second name for the old file, made before the new file takes the part's
    // name: the part's name is never empty, and the backup never holds anything but the old
    // bytes. Killed between the two, the part and its backup are one file with two names; the
    // next save knows that backup by its name and replaces the part by rename again
    // (onlyOtherNameIsABackup), so no save ever writes into a backup.
    const auto backup =
        r.options.backupPath
            ? backupSaying(*r.options.backupPath, [&] { return makeBackup(part, *r.options.backupPath, r.original); })
            : Backup{};
    Undo undoBackup(folder, backup.path);
    const auto oldName = keepAName(part, backup);
    Undo temporaryOldName(folder, backup.secondName ? std::string() : oldName);
    reach(r.options.afterStep, ReplaceStep::BackupMade);
    file.replace(part.name(), [&] {
        ensureUnchanged(part, r.expected);
        reach(r.options.afterStep, ReplaceStep::NewTextNamed);
    });
    folder.sync();
    // Another program that opened the old file before the rename may have written to it since the
    // last look: once it has closed the file (or after a short wait), the old file, with that write,
    // takes its name back.
    if (!oldName.empty()) {
        r.lock.waitUntilOthersClosed(PatienceWithWriters);
        if (part.stamp() != r.expected) {
            ::renameat(folder.fd(), oldName.c_str(), folder.fd(), part.name().c_str());
            folder.sync();
            throw FileChangedError(part.path());
        }
    }
    undoBackup.keep();
    ReplaceResult result{backup.path, writtenPart(part, file)};
    reach(r.options.afterStep, ReplaceStep::Placed);
    return result;
}

// True when the file has two names and the other one is one of its own backups.
bool onlyOtherNameIsABackup(const OpenPart& part, const struct stat& original, const ReplaceOptions& options)
{
    if (original.st_nlink != 2 || !options.isBackupName)
        return false;
    const int listing = ::openat(part.folder().fd(), ".", O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    DIR* entries = listing < 0 ? nullptr : ::fdopendir(listing);
    if (entries == nullptr) {
        if (listing >= 0)
            ::close(listing);
        return false;
    }
    bool found = false;
    while (const auto* entry = ::readdir(entries)) {
        struct stat info {};
        if (options.isBackupName(entry->d_name) &&
            ::fstatat(part.folder().fd(), entry->d_name, &info, AT_SYMLINK_NOFOLLOW) == 0 &&
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

void sweep(const OpenFolder& folder, FolderSweeps* sweeps)
{
    if (sweeps != nullptr) {
        sweeps->sweep(folder);
        return;
    }
    FolderSweeps once;
    once.sweep(folder);
}

} // namespace

FileChangedError::FileChangedError(const std::string& path) : QmError(PathFileAccessError()), path_(path) {}

BackupNotMadeError::BackupNotMadeError(const std::string& backupPath, int errnoValue)
    : QmError(OsError(errnoValue, backupPath).number(),
              "cannot make the backup " + backupPath + ": " + ReasonInWords(errnoValue))
{
}

ChangedWhileSavingError::ChangedWhileSavingError(const std::string& path, const std::string& copyPath)
    : QmError(ErrorNumber::PathFileAccessError,
              path + ": changed while saving; the file as another program left it is in " + copyPath +
                  ", and its old bytes are back")
{
}

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

ReplaceResult ReplacePart(const std::shared_ptr<OpenPart>& part, std::initializer_list<std::string_view> pieces,
                          const ReplaceOptions& options)
{
    sweep(part->folder(), options.sweeps);
    const FileLock lock(*part, options.lockWait);
    reach(options.afterStep, ReplaceStep::Locked);
    if (!part->stillNamed())
        throw FileChangedError(part->path());
    // Unless the restore before the read looked already: a save killed since then changed the
    // part, which the stamp check below sees.
    if (!part->takeKeepExamined())
        RestoreInterruptedRewrite(*part, options.home);
    const auto original = part->status();
    const auto expected = options.expected.value_or(StampOf(original));
    ensureUnchanged(*part, expected);
    // The backup is a new file beside the part: where none can be made (a folder of others, a
    // read-only mount), the save stops before it begins. Without one, a file this user may write
    // in a folder where he may not create files can only be rewritten in place, with the copy of
    // its old bytes in a folder of his own.
    const int noNewFiles = part->folder().whyNoNewFiles();
    if (options.backupPath && noNewFiles != 0)
        throw BackupNotMadeError(*options.backupPath, noNewFiles);
    checkWritable(*part, original);
    const bool hardLinked = original.st_nlink > 1 && !onlyOtherNameIsABackup(*part, original, options);
    const bool keepInode = hardLinked || noNewFiles != 0;
    const Replace replace{part, original, pieces, options, expected, lock};
    std::optional<ReplaceResult> result;
    if (!keepInode)
        result = replaceByRename(replace);
    if (!result) {
        result = rewriteInPlace(replace);
        part->folder().sync();
    }
    return *result;
}

ReplaceResult CreateFileIn(const std::shared_ptr<const OpenFolder>& folder, const std::string& name,
                           const std::string& shownPath, std::initializer_list<std::string_view> pieces)
{
    NewFile file(*folder, shownPath);
    file.write(pieces);
    file.setMode(modeForNewFile());
    file.sync();
    if (!file.linkAs(name))
        throw FileChangedError(shownPath);
    folder->sync();
    auto fd = file.openForReading();
    return {{}, fd.valid() ? std::make_shared<OpenPart>(folder, name, shownPath, std::move(fd)) : nullptr};
}

ReplaceResult ReplaceFileSafely(const std::string& path, std::initializer_list<std::string_view> pieces,
                                const ReplaceOptions& options)
{
    const auto target = ResolveLinks(path);
    const auto folder = OpenFolder::open(FolderOf(target), target);
    const auto name = fileNameOf(target);
    std::shared_ptr<OpenPart> part;
    try {
        part = OpenPart::openIn(folder, name, target);
    } catch (const QmError& error) {
        if (error.number() != ErrorNumber::FileNotFound)
            throw;
        sweep(*folder, options.sweeps);
        return CreateFileIn(folder, name, target, pieces);
    }
    return ReplacePart(part, pieces, options);
}

KeepFinding RestoreInterruptedSave(const OpenPart& part, FolderSweeps* sweeps, const LockWait& wait,
                                   const std::string& home)
{
    sweep(part.folder(), sweeps);
    if (!HasKeepFile(part, home)) {
        part.markKeepExamined();
        return {}; // the usual case, found without taking the lock
    }
    const FileLock lock(part, wait);
    auto found = RestoreInterruptedRewrite(part, home);
    part.markKeepExamined();
    return found;
}
