// SPDX-License-Identifier: MIT
#include "KeepFile.h"

#include <algorithm>
#include <cerrno>
#include <charconv>
#include <cinttypes>
#include <cstdio>
#include <dirent.h>
#include <fcntl.h>
#include <pwd.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>
#include <vector>

#include "FileLock.h"
#include "FileWrites.h"
#include "PartFile.h"

namespace {

constexpr std::string_view KeepPrefix = ".quillmark-keep-";
// Below the home folder: where this user keeps the copies of files in folders he may not write.
constexpr const char* PrivatePath[] = {".local", "state", "Quillmark", "keep"};

std::string keepNameOf(std::uint64_t device, std::uint64_t inode)
{
    return std::string(KeepPrefix) + std::to_string(device) + "-" + std::to_string(inode);
}

std::string keepNameOf(const FileIdentity& identity) { return keepNameOf(identity.device, identity.inode); }

// The keep-file names in the open folder.
std::vector<std::string> keepNamesIn(int folder)
{
    std::vector<std::string> names;
    const int listing = ::openat(folder, ".", O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    DIR* entries = listing < 0 ? nullptr : ::fdopendir(listing);
    if (entries == nullptr) {
        if (listing >= 0)
            ::close(listing);
        return names;
    }
    while (const auto* entry = ::readdir(entries))
        if (unsigned long long device = 0, inode = 0; IsKeepFileName(entry->d_name, device, inode))
            names.emplace_back(entry->d_name);
    ::closedir(entries);
    return names;
}

// The first line of a keep file: the part's identity, then the sizes of the old bytes and of the
// new text that follow it.
std::string recordLine(const FileIdentity& id, std::size_t oldSize, std::size_t newSize)
{
    char line[160];
    std::snprintf(line, sizeof line, "quillmark-keep 2 %" PRIu64 " %" PRIu64 " %" PRId64 " %" PRIu32 " %zu %zu\n",
                  id.device, id.inode, id.bornSeconds, id.bornNanoseconds, oldSize, newSize);
    return line;
}

struct KeepRecord {
    FileIdentity identity;
    std::string_view oldBytes, newText;
};

bool parseRecord(std::string_view keep, KeepRecord& record)
{
    const auto end = keep.find('\n');
    if (end == std::string_view::npos || end > 200)
        return false;
    const std::string line(keep.substr(0, end));
    auto& id = record.identity;
    std::size_t oldSize = 0, newSize = 0;
    if (std::sscanf(line.c_str(), "quillmark-keep 2 %" SCNu64 " %" SCNu64 " %" SCNd64 " %" SCNu32 " %zu %zu",
                    &id.device, &id.inode, &id.bornSeconds, &id.bornNanoseconds, &oldSize, &newSize) != 6)
        return false;
    const auto rest = keep.substr(end + 1);
    if (rest.size() != oldSize + newSize)
        return false;
    record.oldBytes = rest.substr(0, oldSize);
    record.newText = rest.substr(oldSize);
    return true;
}

// The folder of this user's own below his home, made when create is on, with the keep names in it
// when listed is on; null when there is none or when it is not his alone.
std::shared_ptr<const OpenFolder> privateFolder(const std::string& home, bool create, bool listed = false)
{
    if (home.empty())
        return nullptr;
    FileDescriptor folder(::open(home.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    for (const char* step : PrivatePath) {
        if (!folder.valid())
            return nullptr;
        if (create)
            ::mkdirat(folder.get(), step, 0700);
        folder = FileDescriptor(::openat(folder.get(), step, O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC));
    }
    struct stat info {};
    if (!folder.valid() || ::fstat(folder.get(), &info) != 0 || info.st_uid != ::geteuid() || (info.st_mode & 077) != 0)
        return nullptr;
    std::string path = home;
    for (const char* step : PrivatePath)
        path += std::string("/") + step;
    auto names = listed ? std::optional(keepNamesIn(folder.get())) : std::nullopt;
    return std::make_shared<const OpenFolder>(std::move(folder), path, std::move(names));
}

// A keep file stands for a part only when this user made it: it is his and nobody else may write
// it. One that another user put there (a setgid folder gives it the part's group) would have its
// bytes written into a part he may not write.
bool madeByThisUser(const struct stat& keep)
{
    return S_ISREG(keep.st_mode) && keep.st_uid == ::geteuid() && (keep.st_mode & (S_IWGRP | S_IWOTH)) == 0;
}

// A keep file found for a part, open; or the path of one that another user made.
struct FoundKeep {
    std::shared_ptr<const OpenFolder> folder;
    std::string name;
    FileDescriptor fd;
    std::string othersPath;
    FileDescriptor othersFd;
    std::string path() const { return folder->pathOf(name); }
};

// The keep file of the part's name in folder, looked up by name. A command that only reads
// (listings) looks only for a name that the folder's listing saw, so that the usual part, with no
// keep file anywhere, costs no system call; a save never trusts a listing: a keep file made since
// by a save killed meanwhile must be found.
FoundKeep findKeepIn(const OpenPart& part, const std::shared_ptr<const OpenFolder>& folder, bool listings)
{
    FoundKeep found;
    if (!folder)
        return found;
    const auto& listed = folder->listedKeepNames();
    if (listings && listed && listed->empty())
        return found;
    const auto status = part.status();
    const auto name = keepNameOf(status.st_dev, status.st_ino);
    if (listings && listed && std::find(listed->begin(), listed->end(), name) == listed->end())
        return found;
    FileDescriptor fd(::openat(folder->fd(), name.c_str(), O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC));
    struct stat keep {};
    if (!fd.valid() || ::fstat(fd.get(), &keep) != 0 || !S_ISREG(keep.st_mode))
        return found;
    if (madeByThisUser(keep)) {
        found.folder = folder;
        found.name = name;
        found.fd = std::move(fd);
    } else {
        found.othersPath = folder->pathOf(name);
        found.othersFd = std::move(fd);
    }
    return found;
}

// True when current is a state that the rewrite of old into newText, stopped anywhere, leaves: the
// new text's first k bytes, followed by the old bytes from k on where the old text is longer.
bool isInterruptedRewrite(std::string_view current, std::string_view old, std::string_view newText)
{
    if (current.size() < old.size())
        return false;
    const auto common = static_cast<std::size_t>(
        std::mismatch(current.begin(), current.end(), newText.begin(), newText.end()).first - current.begin());
    if (current.size() > old.size())
        return common == current.size();
    auto oldFrom = current.size();
    while (oldFrom > 0 && current[oldFrom - 1] == old[oldFrom - 1])
        --oldFrom;
    return oldFrom <= common;
}

KeepFinding::State judge(std::string_view current, const KeepRecord& record)
{
    using State = KeepFinding::State;
    if (current == record.newText)
        return State::Finished;
    if (current == record.oldBytes)
        return State::Untouched;
    return isInterruptedRewrite(current, record.oldBytes, record.newText) ? State::Restorable : State::Changed;
}

// What another user's keep file says of the part, read and never applied: whether his killed
// save left the part torn.
KeepFinding othersKeep(const OpenPart& part, const FoundKeep& found)
{
    KeepFinding finding{KeepFinding::State::OthersCopy, found.othersPath, {}};
    // His copy holds the old bytes and a new text of about their size: a larger one is no reason
    // to read that much.
    struct stat copy {};
    if (::fstat(found.othersFd.get(), &copy) != 0 || copy.st_size > 2 * part.status().st_size + (off_t{1} << 20))
        return finding;
    const FileBytes keep(found.othersFd.get(), found.othersPath);
    KeepRecord record;
    finding.tornByOthersSave = parseRecord(keep.view(), record) && record.identity == part.identity() &&
                               judge(FileBytes(part).view(), record) == KeepFinding::State::Restorable;
    return finding;
}

// Examines the keep file found, holding its lock (exclusive for a restore) while the finding is
// used; the lock goes with found.fd.
KeepFinding examine(const OpenPart& part, const FoundKeep& found, int lockKind)
{
    KeepFinding finding;
    if (!found.fd.valid())
        return found.othersFd.valid() ? othersKeep(part, found) : finding;
    finding.keepPath = found.path();
    // Where the file system has no locks, nothing tells a live writer: the part's own lock, taken
    // by every save before it looks here, keeps saves apart.
    if (::flock(found.fd.get(), lockKind | LOCK_NB) != 0 && errno == EWOULDBLOCK) {
        finding.state = KeepFinding::State::Busy;
        return finding;
    }
    const FileBytes keep(found.fd.get(), finding.keepPath);
    KeepRecord record;
    if (!parseRecord(keep.view(), record) || record.identity != part.identity()) {
        finding.state = KeepFinding::State::Orphan; // kept for a file that is gone; another has the inode
        return finding;
    }
    const FileBytes current(part);
    finding.state = judge(current.view(), record);
    if (finding.state == KeepFinding::State::Restorable)
        finding.oldBytes = record.oldBytes;
    return finding;
}

// The part's keep file, examined: the one in the part's folder, or where that is none of this
// user's for the part, the one in his own folder (own), where a save goes when the name is taken
// beside the part. Another user's copy or an orphan is the finding only where no keep file of the
// part stands. used: the keep file of the finding, when it is this user's.
KeepFinding findAndExamine(const OpenPart& part, const std::shared_ptr<const OpenFolder>& own, bool listings,
                           int lockKind, FoundKeep& used)
{
    using State = KeepFinding::State;
    KeepFinding first;
    for (const auto& folder : {part.sharedFolder(), own}) {
        auto found = findKeepIn(part, folder, listings);
        auto finding = examine(part, found, lockKind);
        if (finding.state == State::Orphan || finding.state == State::OthersCopy) {
            if (first.state == State::None)
                first = std::move(finding);
        } else if (finding.state != State::None) {
            used = std::move(found);
            return finding;
        }
    }
    return first;
}

// Removes the keep file's name, when it still is the file found.
void removeKeep(const FoundKeep& found)
{
    struct stat named {
    }, held{};
    if (::fstatat(found.folder->fd(), found.name.c_str(), &named, AT_SYMLINK_NOFOLLOW) == 0 &&
        ::fstat(found.fd.get(), &held) == 0 && named.st_ino == held.st_ino && named.st_dev == held.st_dev)
        ::unlinkat(found.folder->fd(), found.name.c_str(), 0);
}

} // namespace

const std::string& HomeOfThisUser()
{
    static const std::string home = [] {
        std::vector<char> buffer(16384);
        struct passwd entry {};
        struct passwd* found = nullptr;
        if (::getpwuid_r(::geteuid(), &entry, buffer.data(), buffer.size(), &found) != 0 || found == nullptr ||
            found->pw_dir == nullptr)
            return std::string();
        return std::string(found->pw_dir);
    }();
    return home;
}

KeepFile::KeepFile(const OpenPart& part, std::string_view oldBytes, std::initializer_list<std::string_view> newText,
                   const std::string& home)
    : name_(keepNameOf(part.identity()))
{
    std::size_t newSize = 0;
    for (const auto piece : newText)
        newSize += piece.size();
    const auto record = recordLine(part.identity(), oldBytes.size(), newSize);
    // A name taken in the part's folder by a file that does not stand for the part sends the copy
    // to this user's own folder.
    for (auto folder : {part.folder().mayCreateFiles() ? part.sharedFolder() : nullptr, privateFolder(home, true)}) {
        if (!folder)
            continue;
        auto file = std::make_unique<NewFile>(*folder, part.path());
        file->write({record, oldBytes});
        file->write(newText);
        file->setMode(0600);
        file->sync();
        if (file->linkAs(name_)) {
            folder->sync();
            folder_ = std::move(folder);
            file_ = std::move(file);
            return;
        }
    }
    throw OsError(part.folder().mayCreateFiles() ? EEXIST : EACCES, part.path());
}

KeepFile::~KeepFile()
{
    if (!kept_ && folder_)
        ::unlinkat(folder_->fd(), name_.c_str(), 0);
}

KeepFinding ExamineKeepFile(const OpenPart& part, const std::string& home)
{
    FoundKeep used;
    return findAndExamine(part, privateFolder(home, false), false, LOCK_SH, used);
}

KeepSearch::KeepSearch(const std::string& home) : own_(privateFolder(home, false, true)) {}

KeepFinding KeepSearch::examine(const OpenPart& part) const
{
    FoundKeep used;
    return findAndExamine(part, own_, true, LOCK_SH, used);
}

bool HasKeepFile(const OpenPart& part, const std::string& home)
{
    for (const auto& folder : {part.sharedFolder(), privateFolder(home, false)}) {
        const auto found = findKeepIn(part, folder, false);
        if (found.fd.valid() || found.othersFd.valid())
            return true;
    }
    return false;
}

KeepNotRestoredError::KeepNotRestoredError(const std::string& path, const std::string& keepPath)
    : QmError(ErrorNumber::PathFileAccessError,
              path + ": an interrupted save was not restored because the file changed since; its old bytes are in " +
                  keepPath)
{
}

std::string OrphanCopyNotice(const std::string& keepPath)
{
    return keepPath + ": the copy an interrupted save kept of a file that is gone; it is left as it is";
}

std::string OthersCopyNotice(const std::string& path, const KeepFinding& finding)
{
    return path + ": a copy left by another user's interrupted save is at " + finding.keepPath +
           "; it was not applied" +
           (finding.tornByOthersSave ? "; the file stays as that save left it until that user saves it again" : "");
}

KeepFinding RestoreInterruptedRewrite(const OpenPart& part, const std::string& home)
{
    FoundKeep found;
    auto finding = findAndExamine(part, privateFolder(home, false), false, LOCK_EX, found);
    using State = KeepFinding::State;
    switch (finding.state) {
    case State::None:
    case State::OthersCopy:
    case State::Orphan: return finding;
    case State::Busy: throw FileLockedError(part.path());
    case State::Changed: throw KeepNotRestoredError(part.path(), finding.keepPath);
    case State::Restorable: {
        const auto writable = part.openForWriting();
        OverwriteFile(writable.get(), {finding.oldBytes}, part.path());
        break;
    }
    case State::Untouched:
    case State::Finished: break;
    }
    removeKeep(found);
    found.folder->sync();
    return finding;
}

bool IsKeepFileName(std::string_view name, unsigned long long& device, unsigned long long& inode)
{
    if (!name.starts_with(KeepPrefix))
        return false;
    const auto* begin = name.data() + KeepPrefix.size();
    const auto* end = name.data() + name.size();
    const auto [afterDevice, deviceError] = std::from_chars(begin, end, device);
    if (deviceError != std::errc() || afterDevice == end || *afterDevice != '-')
        return false;
    const auto [afterInode, inodeError] = std::from_chars(afterDevice + 1, end, inode);
    return inodeError == std::errc() && afterInode == end;
}
