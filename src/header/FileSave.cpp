#include "FileSave.h"

#include <cerrno>
#include <cstdio>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include "ErrorReport.h"
#include "Text.h"

namespace {

const Procedure FileSaveProcedure{"FileSave", OwnerKind::Module, "modQuillmark"};

std::string stampText(const LocalDateTime& t)
{
    char text[64];
    std::snprintf(text, sizeof text, "%04d-%02d-%02d_%02d-%02d-%02d", t.year, t.month, t.day, t.hour, t.minute,
                  t.second);
    return text;
}

std::string folderForTemporaryFile(const std::string& path)
{
    const auto slash = path.rfind('/');
    if (slash == std::string::npos)
        return ".";
    return slash == 0 ? "/" : path.substr(0, slash);
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

// The temporary file holding the new text; removed again unless it was put in place.
class TemporaryFile {
public:
    TemporaryFile(const std::string& folder, const std::string& finalPath) : path_(folder + "/.quillmark-save-XXXXXX")
    {
        fd_ = ::mkstemp(path_.data());
        if (fd_ < 0)
            throw OsError(errno, finalPath);
    }
    ~TemporaryFile()
    {
        if (fd_ >= 0)
            ::close(fd_);
        if (!placed_)
            ::unlink(path_.c_str());
    }
    TemporaryFile(const TemporaryFile&) = delete;
    TemporaryFile& operator=(const TemporaryFile&) = delete;

    void write(std::initializer_list<std::string_view> pieces, const struct stat* original, const std::string& finalPath)
    {
        for (const auto piece : pieces)
            writeAll(fd_, piece, finalPath);
        const mode_t mode = original ? (original->st_mode & 07777) : modeForNewFile();
        if (original) {
            // Only root can keep another user's ownership; anyone else's save stays theirs.
            [[maybe_unused]] const int ignored = ::fchown(fd_, original->st_uid, original->st_gid);
        }
        if (::fchmod(fd_, mode) != 0 || ::fsync(fd_) != 0)
            throw OsError(errno, finalPath);
        const int fd = fd_;
        fd_ = -1;
        if (::close(fd) != 0)
            throw OsError(errno, finalPath);
    }

    void placeAt(const std::string& finalPath)
    {
        if (::rename(path_.c_str(), finalPath.c_str()) != 0)
            throw OsError(errno, finalPath);
        placed_ = true;
    }

private:
    std::string path_;
    int fd_ = -1;
    bool placed_ = false;
};

// The old content under the backup name: a second name for the same file where the file system
// allows it (so the part file itself is never missing), otherwise the file is moved right before
// the new one takes its place. Undone unless committed.
class Backup {
public:
    Backup(const std::string& path, const std::string& backupPath) : path_(path), backupPath_(backupPath)
    {
        if (::link(path.c_str(), backupPath.c_str()) == 0) {
            linked_ = true;
            return;
        }
        const int linkError = errno;
        if (linkError != EPERM && linkError != EXDEV && linkError != EMLINK && linkError != ENOTSUP)
            throw OsError(linkError, linkError == EEXIST ? backupPath : path);
        struct stat info {};
        if (::lstat(backupPath.c_str(), &info) == 0)
            throw OsError(EEXIST, backupPath);
    }
    ~Backup()
    {
        if (committed_)
            return;
        if (linked_)
            ::unlink(backupPath_.c_str());
        else if (moved_)
            ::rename(backupPath_.c_str(), path_.c_str());
    }
    Backup(const Backup&) = delete;
    Backup& operator=(const Backup&) = delete;

    void moveOldFileAside()
    {
        if (linked_)
            return;
        if (::rename(path_.c_str(), backupPath_.c_str()) != 0)
            throw OsError(errno, path_);
        moved_ = true;
    }
    void commit() { committed_ = true; }

private:
    std::string path_;
    std::string backupPath_;
    bool linked_ = false;
    bool moved_ = false;
    bool committed_ = false;
};

} // namespace

std::string MakeBackupName(const std::string& path, const LocalDateTime& stamp)
{
    const auto trimmed = std::string(TrimBlanks(path));
    std::string folderWithSlash, base = "unbenannt", extension = "txt";
    if (!trimmed.empty()) {
        const auto slash = trimmed.rfind('/');
        folderWithSlash = slash == std::string::npos ? std::string() : trimmed.substr(0, slash + 1);
        const auto fileName = trimmed.substr(folderWithSlash.size());
        const auto dot = fileName.find('.');
        if (dot == std::string::npos)
            throw InvalidCallError();
        base = fileName.substr(0, dot);
        extension = fileName.substr(dot + 1);
    }
    return folderWithSlash + base + "_Backup_" + stampText(stamp) + "." + extension;
}

void ReplaceFileSafely(const std::string& path, std::initializer_list<std::string_view> pieces,
                       const std::optional<std::string>& backupPath)
{
    struct stat original {};
    const bool exists = ::stat(path.c_str(), &original) == 0;
    if (exists && (original.st_mode & 0222) == 0)
        throw QmError(ErrorNumber::PermissionDenied, "Permission denied");
    std::optional<Backup> backup;
    if (backupPath)
        backup.emplace(path, *backupPath);
    TemporaryFile temporary(folderForTemporaryFile(path), path);
    temporary.write(pieces, exists ? &original : nullptr, path);
    if (backup)
        backup->moveOldFileAside();
    temporary.placeAt(path);
    if (backup)
        backup->commit();
}

FileSaveResult FileSave(HeaderData& header, const std::string& newHeader, bool makeBackup, const Clock& clock,
                        Dialogs& dialogs)
{
    FileSaveResult result;
    try {
        std::optional<std::string> backupPath;
        if (makeBackup)
            backupPath = MakeBackupName(header.FilePath, clock.now());
        ReplaceFileSafely(header.FilePath, {newHeader, header.Body, CrLf}, backupPath);
        header.FileChanged = false;
        result.saved = true;
        result.backupPath = backupPath.value_or(std::string());
    } catch (const QmError& error) {
        ReportError(dialogs, error, FileSaveProcedure);
    }
    return result;
}
