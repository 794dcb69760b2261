// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <initializer_list>
#include <optional>
#include <string>
#include <string_view>

#include "FileStamp.h"
#include "QmError.h"

class FolderSweeps;

// The path a save writes to: path with the symbolic links at its end followed, so that saving
// through a link changes the file it points to and the link stays a link. A path that is no
// link comes back as it is.
std::string ResolveLinks(const std::string& path);

// The points between the steps of a replace, where a test can stop a save as a kill would.
enum class ReplaceStep { NewTextWritten, BackupMade, NewTextNamed, Placed };
using ReplaceStepHook = std::function<void(ReplaceStep)>;

struct ReplaceOptions {
    // Where the old content goes; when that name exists, " (2)", " (3)"... is put before the
    // first "." of its file name instead. None: no backup.
    std::optional<std::string> backupPath;
    // True for the file name of one of this file's earlier backups, which may share its inode
    // when a save was killed between making the backup and renaming.
    std::function<bool(std::string_view fileName)> isBackupName;
    // The stamp of what the caller read and changed; none: the file as the replace finds it.
    std::optional<FileStamp> expected;
    // Leftover temporary files are looked for once per folder in a run; none: every time.
    FolderSweeps* sweeps = nullptr;
    ReplaceStepHook afterStep;
};

struct ReplaceResult {
    std::string backupPath; // the name the backup took, when one was made
};

// The file changed on disk (another program wrote, replaced or removed it) between the read
// and the moment the new text would take its name. Nothing was written.
class FileChangedError : public QmError {
public:
    explicit FileChangedError(const std::string& path);
    const std::string& path() const { return path_; }

private:
    std::string path_;
};

// Replaces the content of the file at path (links followed) by the pieces, one after the other,
// so that the file is never broken, never missing and never another user's:
// - the new text goes to a temporary file in the same folder that has no name until it is
//   complete and on disk, gets the old file's owner, permissions and extended attributes, and
//   then takes the file's name in one rename;
// - a file with several hard links, one whose owner or attributes a new file could not keep, or
//   one in a folder where this user may not create files, is rewritten in place instead, after a
//   copy of its old bytes is safe on disk (a keep file), and restored from that copy if writing
//   fails or, when the process is killed, by the next open or save;
// - with a backup path, the old content ends under that name (a second name for the old file,
//   or a copy of it);
// - a file this user may not write, or that has no write permission at all, is refused;
// - a file that changed since expected is left alone (FileChangedError), checked again right
//   before the new text takes its name; Quillmark processes saving one file take turns.
// On any failure the file keeps its old content, nothing else is left behind, and QmError is
// thrown.
ReplaceResult ReplaceFileSafely(const std::string& path, std::initializer_list<std::string_view> pieces,
                                const ReplaceOptions& options = {});

// Undoes the in-place rewrite of the file at path (links followed) that a killed process left
// half done, and removes what killed saves left in its folder; true when old bytes were written
// back. sweeps: see ReplaceOptions.
bool RestoreInterruptedSave(const std::string& path, FolderSweeps* sweeps = nullptr);
