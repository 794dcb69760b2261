// SPDX-License-Identifier: MIT
#pragma once

#include <array>
#include <string>
#include <string_view>

#include "Clock.h"
#include "Dialogs.h"
#include "HeaderData.h"

#include "SafeReplace.h"

class Dialogs;

// "folder/base_Backup_YYYY-MM-DD_hh-mm-ss.extension", the base being the file name up to its first
// "." and the extension all after it. A path without a folder gives a name without one; a blank
// path gives "unbenannt_Backup_....txt". A file name without "." throws QmError 5.
std::string MakeBackupName(const std::string& path, const LocalDateTime& stamp);

// True when a file name (without folder) has the form MakeBackupName gives, with or without a
// " (n)" after the stamp.
bool IsBackupName(std::string_view fileName);

// The title of the question asked before overwriting a file that changed since it was read.
inline constexpr const char* ChangedOnDiskTitle = Translatable("Messages", "File Changed on Disk");
// The titles of the boxes that say why a save or an open stopped short.
inline constexpr const char* FileLockedTitle = Translatable("Messages", "File Locked");
inline constexpr const char* InterruptedTitle = Translatable("Messages", "Interrupted");
inline constexpr const char* KeptCopyTitle = Translatable("Messages", "Interrupted Save");

// What a save writes, piece by piece: what stood before the header, the new header, the body
// and one CR LF.
std::array<std::string_view, 4> SavedPieces(const HeaderData& header, const std::string& newHeader);

// The text a save writes, in one piece.
std::string SavedText(const HeaderData& header, const std::string& newHeader);

// True when the file read, still under its name, holds exactly what a save would write.
bool FileHoldsSavedText(const HeaderData& header, const std::string& newHeader);

struct FileSaveResult {
    bool saved = false;
    std::string backupPath;
};

// Writes newHeader, the body and one CR LF over the part read (the file FilePath links to), after
// a dated backup beside that file when makeBackup is on (numbered when that name is taken), and
// clears FileChanged. A file that changed on disk since it was read, up to the moment the new
// text takes its name, is only overwritten when the user says so. A failure is reported through
// dialogs, and FileChanged stays. run: the sweeps, the lock wait and the home of the run (see
// ReplaceOptions). The header written is kept as HeaderAtOpenOrSave, the file written as Part.
FileSaveResult FileSave(HeaderData& header, std::string newHeader, bool makeBackup, const Clock& clock,
                        Dialogs& dialogs, const ReplaceOptions& run = {});

// Writes text, the file's own bytes edited, over the part read as FileSave writes a header; the
// record's header is not kept as saved.
FileSaveResult FileSaveText(HeaderData& header, std::string_view text, bool makeBackup, const Clock& clock,
                            Dialogs& dialogs, const ReplaceOptions& run = {});

enum class RestoreOutcome { NothingToDo, Restored, CopyKept };

// Undoes what a save killed in the middle of rewriting the part in place left there, and says so:
// "restored <path> from an interrupted save". When the part changed since, the copy of its old
// bytes stays, and a box says where (CopyKept).
RestoreOutcome RestoreInterruptedSaveOf(const OpenPart& part, Dialogs& dialogs, const ReplaceOptions& run = {});
