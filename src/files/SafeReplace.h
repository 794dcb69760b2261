// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <initializer_list>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

#include "FileLock.h"
#include "FileStamp.h"
#include "KeepFile.h"
#include "OpenPart.h"
#include "QmError.h"

class FolderSweeps;

// The path a save writes to: path with the symbolic links at its end followed, so that saving
// through a link changes the file it points to and the link stays a link. A path that is no
// link comes back as it is.
std::string ResolveLinks(const std::string& path);

// The points between the steps of a replace, where a test can stop a save as a kill would, or
// act as another program would between two steps.
// WrittenInPlace: an in-place rewrite wrote its last byte and has not yet cut the file to length.
enum class ReplaceStep { Locked, NewTextWritten, BackupMade, WrittenInPlace, NewTextNamed, Placed };
using ReplaceStepHook = std::function<void(ReplaceStep)>;

struct ReplaceOptions {
    // Where the old content goes, in the part's folder; when that name exists, " (2)", " (3)"...
    // is put before the first "." of its file name instead. None: no backup.
    std::optional<std::string> backupPath;
    // True for the file name of one of this file's earlier backups, which may share its inode
    // when a save was killed between making the backup and renaming.
    std::function<bool(std::string_view fileName)> isBackupName;
    // The stamp of what the caller read and changed; none: the file as the replace finds it.
    std::optional<FileStamp> expected;
    // Leftover temporary files are looked for once per folder in a run; none: every time.
    FolderSweeps* sweeps = nullptr;
    LockWait lockWait;
    // The saving user's home folder, below which he keeps the copies of files in folders where
    // he may not create files.
    std::string home = HomeOfThisUser();
    ReplaceStepHook afterStep;
};

struct ReplaceResult {
    std::string backupPath;            // the name the backup took, when one was made
    std::shared_ptr<OpenPart> written; // the file that holds the new text now
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

// The backup could not be made; the message names it and the system's reason in words.
class BackupNotMadeError : public QmError {
public:
    BackupNotMadeError(const std::string& backupPath, int errnoValue);
};

// Another program wrote to the part while it was rewritten in place. The file as it stood then is
// in a copy whose path the message names, and the part holds its old bytes again.
class ChangedWhileSavingError : public QmError {
public:
    ChangedWhileSavingError(const std::string& path, const std::string& copyPath);
};

// Replaces the content of the open part by the pieces, one after the other, so that the file is
// never broken, never missing and never another user's:
// - the new text goes to a new file in the part's folder that has no name until it is complete
//   and on disk, gets the old file's owner, permissions and extended attributes, and then takes
//   the part's name in one rename;
// - a file with several hard links, one whose owner or attributes a new file could not keep, or
//   one in a folder where this user may not create files, is rewritten in place through its own
//   descriptor instead, after a copy of its old bytes is safe on disk (a keep file), and restored
//   from that copy if writing fails or, when the process is killed, by the next open or save; a
//   change by another program seen during the rewrite (ChangedWhileSavingError) leaves the file
//   as it stood in a copy beside the keep file, and the old bytes in the part;
// - with a backup path, the old content ends under that name (a second name for the old file,
//   or a copy of it);
// - a file this user may not write, or that has no write permission at all, is refused;
// - a file that changed since expected, or whose name came to stand for another file, is left
//   alone (FileChangedError), checked again right before the new text takes its name;
//   Quillmark processes saving one file take turns.
// Every step works on the part's descriptor or relative to its folder's. On any failure the file
// keeps its old content, nothing else is left behind, and QmError is thrown.
ReplaceResult ReplacePart(const std::shared_ptr<OpenPart>& part, std::initializer_list<std::string_view> pieces,
                          const ReplaceOptions& options = {});

// Gives the pieces the name in folder, where no file has it yet (FileChangedError when one has),
// with the permissions a new file gets.
ReplaceResult CreateFileIn(const std::shared_ptr<const OpenFolder>& folder, const std::string& name,
                           const std::string& shownPath, std::initializer_list<std::string_view> pieces);

// The file at path, opened as OpenPart::openPath does, replaced by ReplacePart; created when
// there is none.
ReplaceResult ReplaceFileSafely(const std::string& path, std::initializer_list<std::string_view> pieces,
                                const ReplaceOptions& options = {});

// Under the part's lock, undoes the in-place rewrite of the part that a killed process left half
// done (see RestoreInterruptedRewrite), after removing what killed saves left in its folder
// (sweeps: see ReplaceOptions); returns what it found (Restorable: the old bytes went back).
KeepFinding RestoreInterruptedSave(const OpenPart& part, FolderSweeps* sweeps = nullptr, const LockWait& wait = {},
                                   const std::string& home = HomeOfThisUser());
