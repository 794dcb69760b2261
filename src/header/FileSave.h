#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "Clock.h"
#include "HeaderData.h"

class Dialogs;

// "folder/base_Backup_YYYY-MM-DD_hh-mm-ss.extension", the base being the file name up to its first
// "." and the extension all after it. A path without a folder gives a name without one; a blank
// path gives "unbenannt_Backup_....txt". A file name without "." throws QmError 5.
std::string MakeBackupName(const std::string& path, const LocalDateTime& stamp);

// Replaces the file at path by the pieces, one after the other, without ever leaving it broken:
// the new text goes to a temporary file in the same folder, reaches the disk, and only then
// takes the file's name. With a backup path, the old content ends under that name. On any
// failure the file keeps its old content, nothing else is left behind, and QmError is thrown.
void ReplaceFileSafely(const std::string& path, std::initializer_list<std::string_view> pieces,
                       const std::optional<std::string>& backupPath);

struct FileSaveResult {
    bool saved = false;
    std::string backupPath;
};

// Writes newHeader, the body and one CR LF to FilePath, after a dated backup when makeBackup is
// on, and clears FileChanged. A failure is reported through dialogs and FileChanged stays.
FileSaveResult FileSave(HeaderData& header, const std::string& newHeader, bool makeBackup, const Clock& clock,
                        Dialogs& dialogs);
