// SPDX-License-Identifier: MIT
#include "PartFileList.h"

#include <algorithm>
#include <cerrno>
#include <dirent.h>
#include <fcntl.h>
#include <memory>
#include <sys/stat.h>
#include <system_error>
#include <unistd.h>

#include "FileSave.h"
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

// One folder at a time, depth first, without recursion: a level holds the names of its subfolders
// still to visit, and the path grows and shrinks as the walk goes down and up.
class FolderWalk {
public:
    explicit FolderWalk(PartFileList& found) : found_(found) {}

    void run(const std::string& root)
    {
        const auto firstFile = found_.files.size();
        std::string path = root;
        std::vector<Level> levels;
        levels.push_back({read(path, true), 0, path.size()});
        while (!levels.empty()) {
            auto& level = levels.back();
            if (level.next == level.subfolders.size()) {
                levels.pop_back();
                continue;
            }
            path.resize(level.pathSize);
            appendName(path, level.subfolders[level.next++]);
            auto subfolders = read(path, false);
            levels.push_back({std::move(subfolders), 0, path.size()});
        }
        std::sort(found_.files.begin() + static_cast<std::ptrdiff_t>(firstFile), found_.files.end());
    }

private:
    struct Level {
        std::vector<std::string> subfolders;
        std::size_t next;
        std::size_t pathSize;
    };

    // Takes the part files of the folder at path and returns the names of its subfolders. The
    // folder named on the command line may be a link; one met on the walk was seen not to be.
    std::vector<std::string> read(const std::string& path, bool named)
    {
        std::vector<std::string> subfolders;
        const int descriptor = ::open(path.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC | (named ? 0 : O_NOFOLLOW));
        std::unique_ptr<DIR, DirCloser> dir(descriptor < 0 ? nullptr : ::fdopendir(descriptor));
        if (!dir) {
            note(path, errno);
            if (descriptor >= 0)
                ::close(descriptor);
            return subfolders;
        }
        for (;;) {
            errno = 0;
            const dirent* entry = ::readdir(dir.get());
            if (entry == nullptr) {
                if (errno != 0)
                    note(path, errno);
                return subfolders;
            }
            const std::string_view name = entry->d_name;
            if (name != "." && name != "..")
                take(::dirfd(dir.get()), path, name, entry->d_type, subfolders);
        }
    }

    void take(int folder, const std::string& path, std::string_view name, unsigned char type,
              std::vector<std::string>& subfolders)
    {
        if (type == DT_UNKNOWN)
            type = typeOf(folder, path, name);
        if (type == DT_DIR)
            subfolders.emplace_back(name);
        else if (type == DT_LNK)
            found_.linksSkipped += isPartFileName(name) || linksToFolder(folder, name) ? 1 : 0;
        else if (type == DT_REG && isPartFileName(name)) {
            if (IsBackupName(name))
                ++found_.backupsSkipped;
            else
                appendName(found_.files.emplace_back(path), name);
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
};

bool isFolder(const std::string& path)
{
    struct stat info {};
    return ::stat(path.c_str(), &info) == 0 && S_ISDIR(info.st_mode);
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
            found.files.push_back(argument);
    }
    return found;
}
