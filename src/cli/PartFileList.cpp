// SPDX-License-Identifier: MIT
#include "PartFileList.h"

#include <algorithm>
#include <cerrno>
#include <dirent.h>
#include <fcntl.h>
#include <memory>
#include <sys/resource.h>
#include <sys/stat.h>
#include <system_error>
#include <unistd.h>

#include "FileSave.h"
#include "KeepFile.h"
#include "QmError.h"
#include "Text.h"

namespace {

bool isPartFileName(std::string_view name)
{
    return name.size() >= 4 && ToLowerAscii(name.substr(name.size() - 4)) == ".dat";
}

void appendName(std::string& path, std::string_view name)
{
    if (!path.ends_with('/'))
        path += '/';
    path += name;
}

struct DirCloser {
    void operator()(DIR* dir) const { ::closedir(dir); }
};

bool isFolderSeen(int fd, const FolderTrail& trail)
{
    struct stat info {};
    return ::fstat(fd, &info) == 0 && info.st_dev == trail.device && info.st_ino == trail.inode;
}

using Dir = std::unique_ptr<DIR, DirCloser>;

// The folder fd as a listing that owns it; null, with fd closed, when it cannot be listed.
Dir listingOf(int fd)
{
    Dir dir(fd < 0 ? nullptr : ::fdopendir(fd));
    if (!dir && fd >= 0)
        ::close(fd);
    return dir;
}

std::shared_ptr<FolderTrail> trailOf(DIR* dir, std::shared_ptr<const FolderTrail> parent, std::string name)
{
    struct stat info {};
    ::fstat(::dirfd(dir), &info);
    return std::make_shared<FolderTrail>(FolderTrail{std::move(parent), std::move(name), info.st_dev, info.st_ino, {}});
}

// The folders a walk holds open for the files found in them: a file is then opened with one call,
// never through a folder put in the place of the one listed. Beyond that number (a descriptor
// each), a folder is found again along its trail.
constexpr std::size_t HeldFolders = 256;

// One folder at a time, depth first, without recursion: a level holds the names of its subfolders
// still to visit, and the path grows and shrinks as the walk goes down and up. Each subfolder is
// opened in its parent's descriptor without following a link, and the walk goes back up through
// "..", checked to be the folder it came from.
class FolderWalk {
public:
    explicit FolderWalk(PartFileList& found) : found_(found)
    {
        struct rlimit limit {};
        descriptorLimit_ = ::getrlimit(RLIMIT_NOFILE, &limit) == 0 ? limit.rlim_cur : 0;
    }

    void run(const std::string& root)
    {
        const auto firstFile = found_.files.size();
        Dir current = listingOf(::open(root.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
        if (!current) {
            note(root, errno);
            return;
        }
        std::string path = root;
        std::vector<Level> levels;
        levels.push_back(read(current.get(), path, trailOf(current.get(), nullptr, root)));
        while (!levels.empty()) {
            auto& level = levels.back();
            path.resize(level.pathSize);
            if (level.next == level.subfolders.size()) {
                levels.pop_back();
                if (!levels.empty() && !goUp(current, *levels.back().trail, path))
                    break;
                continue;
            }
            const auto& name = level.subfolders[level.next++];
            appendName(path, name);
            Dir child = listingOf(
                ::openat(::dirfd(current.get()), name.c_str(), O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC));
            if (!child) {
                note(path, errno);
                continue;
            }
            auto trail = trailOf(child.get(), level.trail, name);
            current = std::move(child);
            levels.push_back(read(current.get(), path, std::move(trail)));
        }
        std::sort(found_.files.begin() + static_cast<std::ptrdiff_t>(firstFile), found_.files.end(),
                  [](const PartFileEntry& a, const PartFileEntry& b) { return a.path < b.path; });
    }

private:
    struct Level {
        std::vector<std::string> subfolders;
        std::size_t next = 0;
        std::size_t pathSize = 0;
        std::shared_ptr<FolderTrail> trail;
    };

    // Back to the parent; false, with the rest of this walk given up, when the folder was moved
    // out of it meanwhile.
    bool goUp(Dir& current, const FolderTrail& parent, const std::string& path)
    {
        current = listingOf(::openat(::dirfd(current.get()), "..", O_RDONLY | O_DIRECTORY | O_CLOEXEC));
        if (current && isFolderSeen(::dirfd(current.get()), parent))
            return true;
        found_.problems.push_back({path, "moved while it was read"});
        return false;
    }

    // Takes the part files of the open folder and returns the names of its subfolders. The
    // folder named on the command line may be a link; one met on the walk was seen not to be.
    Level read(DIR* dir, const std::string& path, std::shared_ptr<FolderTrail> trail)
    {
        Level level;
        level.trail = std::move(trail);
        level.pathSize = path.size();
        const int folder = ::dirfd(dir);
        std::vector<ino_t> inodes;
        for (;;) {
            errno = 0;
            const dirent* entry = ::readdir(dir);
            if (entry == nullptr) {
                if (errno != 0)
                    note(path, errno);
                break;
            }
            const std::string_view name = entry->d_name;
            inodes.push_back(entry->d_ino);
            if (name != "." && name != "..")
                take(folder, path, name, entry->d_type, level);
        }
        noteOrphanKeepFiles(path, *level.trail, inodes);
        hold(folder, path, *level.trail);
        keepFileCandidates_.clear();
        return level;
    }

    // Holds the folder for its files while descriptors are plenty: the walk itself and the files
    // open at once need the other half.
    void hold(int folder, const std::string& path, FolderTrail& trail)
    {
        if (held_ == HeldFolders)
            return;
        FileDescriptor copy(::fcntl(folder, F_DUPFD_CLOEXEC, 0));
        if (!copy.valid() || static_cast<rlim_t>(copy.get()) >= descriptorLimit_ / 2)
            return;
        ++held_;
        trail.held = std::make_shared<const OpenFolder>(std::move(copy), path, keepFileCandidates_);
    }

    void take(int folder, const std::string& path, std::string_view name, unsigned char type, Level& level)
    {
        if (type == DT_UNKNOWN)
            type = typeOf(folder, path, name);
        if (type == DT_DIR)
            level.subfolders.emplace_back(name);
        else if (type == DT_LNK)
            found_.linksSkipped += isPartFileName(name) || linksToFolder(folder, name) ? 1 : 0;
        else if (type == DT_REG && isPartFileName(name)) {
            if (IsBackupName(name))
                ++found_.backupsSkipped;
            else {
                auto& entry = found_.files.emplace_back(PartFileEntry{path, level.trail, std::string(name)});
                appendName(entry.path, name);
            }
        } else if (unsigned long long device = 0, inode = 0; type == DT_REG && IsKeepFileName(name, device, inode))
            keepFileCandidates_.emplace_back(name);
    }

    // The keep files in a folder whose file is no longer there: reported, never applied.
    void noteOrphanKeepFiles(const std::string& path, const FolderTrail& trail, const std::vector<ino_t>& inodes)
    {
        for (const auto& name : keepFileCandidates_) {
            unsigned long long device = 0, inode = 0;
            if (IsKeepFileName(name, device, inode) && device == trail.device &&
                std::find(inodes.begin(), inodes.end(), inode) == inodes.end()) {
                auto keepPath = path;
                appendName(keepPath, name);
                found_.orphanKeepFiles.push_back(std::move(keepPath));
            }
        }
    }

    // For file systems that do not tell the type while listing.
    unsigned char typeOf(int folder, const std::string& path, std::string_view name)
    {
        struct stat info {};
        if (::fstatat(folder, std::string(name).c_str(), &info, AT_SYMLINK_NOFOLLOW) != 0) {
            if (errno != ENOENT) { // gone since it was listed: nothing to report
                auto entry = path;
                appendName(entry, name);
                note(entry, errno);
            }
            return DT_UNKNOWN;
        }
        return S_ISDIR(info.st_mode)   ? DT_DIR
               : S_ISLNK(info.st_mode) ? DT_LNK
               : S_ISREG(info.st_mode) ? DT_REG
                                       : DT_UNKNOWN;
    }

    static bool linksToFolder(int folder, std::string_view name)
    {
        struct stat info {};
        return ::fstatat(folder, std::string(name).c_str(), &info, 0) == 0 && S_ISDIR(info.st_mode);
    }

    void note(const std::string& path, int error)
    {
        found_.problems.push_back({path, std::generic_category().message(error)});
    }

    PartFileList& found_;
    std::vector<std::string> keepFileCandidates_;
    std::size_t held_ = 0;
    rlim_t descriptorLimit_ = 0;
};

bool isFolder(const std::string& path)
{
    struct stat info {};
    return ::stat(path.c_str(), &info) == 0 && S_ISDIR(info.st_mode);
}

// The folder a trail names, opened from the folder named down, each step no link and each the
// folder the walk saw.
std::shared_ptr<const OpenFolder> openTrail(const FolderTrail& trail)
{
    if (trail.held)
        return trail.held;
    auto folder = trail.parent ? openTrail(*trail.parent)->openSubfolder(trail.name) : OpenFolder::open(trail.name);
    if (!isFolderSeen(folder->fd(), trail))
        throw PathFileAccessError();
    return folder;
}

} // namespace

PartFileList ExpandPartFiles(const std::vector<std::string>& arguments)
{
    PartFileList found;
    FolderWalk walk(found);
    for (const auto& argument : arguments) {
        if (isFolder(argument))
            walk.run(argument);
        else
            found.files.push_back({argument, nullptr, {}});
    }
    return found;
}

std::shared_ptr<OpenPart> OpenEntry(const PartFileEntry& entry)
{
    if (!entry.folder)
        return OpenPart::openPath(entry.path);
    return OpenPart::openIn(openTrail(*entry.folder), entry.name, entry.path);
}
