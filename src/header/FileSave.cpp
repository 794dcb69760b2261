// SPDX-License-Identifier: MIT
#include "FileSave.h"

#include <cstdio>

#include "Dialogs.h"
#include "ErrorReport.h"
#include "SafeReplace.h"
#include "SameBytes.h"
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

// The form of stampText's result, "d" standing for a digit.
constexpr std::string_view StampForm = "dddd-dd-dd_dd-dd-dd";

bool isStampText(std::string_view text)
{
    if (text.size() != StampForm.size())
        return false;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const bool digit = text[i] >= '0' && text[i] <= '9';
        if (StampForm[i] == 'd' ? !digit : text[i] != StampForm[i])
            return false;
    }
    return true;
}

// The base of a file name without the " (2)", " (3)"... that tells backups of one second apart.
std::string_view withoutCopyNumber(std::string_view base)
{
    const auto open = base.rfind(" (");
    if (open == std::string_view::npos || !base.ends_with(')'))
        return base;
    const auto number = base.substr(open + 2, base.size() - open - 3);
    const bool digits = !number.empty() && number.find_first_not_of("0123456789") == std::string_view::npos;
    return digits ? base.substr(0, open) : base;
}

MessageBox changedOnDiskBox(const std::string& path)
{
    return {"The file " + path +
                " was changed by another program after it was opened.\r\n"
                "Save anyway and overwrite those changes?",
            ChangedOnDiskTitle, Buttons::YesNo, Icon::Exclamation, Answer::No};
}

struct NameParts {
    std::string folderWithSlash, base, extension;
};

// The base is the file name up to its first "." and the extension all after it.
NameParts namePartsOf(const std::string& path)
{
    // Only a blank path is trimmed: the blanks of a real one belong to its file's name.
    if (TrimBlanks(path).empty())
        return {"", "unbenannt", "txt"};
    const auto slash = path.rfind('/');
    const auto folderWithSlash = slash == std::string::npos ? std::string() : path.substr(0, slash + 1);
    const auto fileName = path.substr(folderWithSlash.size());
    const auto dot = fileName.find('.');
    if (dot == std::string::npos)
        throw InvalidCallError();
    return {folderWithSlash, fileName.substr(0, dot), fileName.substr(dot + 1)};
}

std::string backupMark(const NameParts& name) { return name.base + "_Backup_"; }

// The file names this program gives the backups of the file at path.
ReplaceOptions backupOptions(const std::string& path, bool makeBackup, const Clock& clock)
{
    ReplaceOptions options;
    if (makeBackup)
        options.backupPath = MakeBackupName(path, clock.now());
    options.isBackupName = [name = namePartsOf(path)](std::string_view fileName) {
        return IsBackupName(fileName) && fileName.starts_with(backupMark(name)) &&
               fileName.ends_with("." + name.extension);
    };
    return options;
}

} // namespace

std::string MakeBackupName(const std::string& path, const LocalDateTime& stamp)
{
    const auto name = namePartsOf(path);
    return name.folderWithSlash + backupMark(name) + stampText(stamp) + "." + name.extension;
}

void RestoreInterruptedSaveOf(const std::string& path, Dialogs& dialogs, FolderSweeps* sweeps)
{
    if (RestoreInterruptedSave(path, sweeps))
        dialogs.message({"restored " + path + " from an interrupted save", "Quillmark", Buttons::Ok, Icon::Information,
                         Answer::Ok});
}

bool IsBackupName(std::string_view fileName)
{
    const auto dot = fileName.find('.');
    if (dot == std::string_view::npos)
        return false;
    const auto base = withoutCopyNumber(fileName.substr(0, dot));
    constexpr std::string_view Marker = "_Backup_";
    if (base.size() < Marker.size() + StampForm.size())
        return false;
    const auto stampStart = base.size() - StampForm.size();
    return isStampText(base.substr(stampStart)) && base.substr(stampStart - Marker.size(), Marker.size()) == Marker;
}

std::array<std::string_view, 4> SavedPieces(const HeaderData& header, const std::string& newHeader)
{
    return {TextBeforeHeader(header), newHeader, header.Body, CrLf};
}

std::string SavedText(const HeaderData& header, const std::string& newHeader)
{
    std::string text;
    for (const auto piece : SavedPieces(header, newHeader))
        text += piece;
    return text;
}

bool FileHoldsSavedText(const HeaderData& header, const std::string& newHeader)
{
    return FileHoldsExactly(header.FilePath, SavedPieces(header, newHeader));
}

FileSaveResult FileSave(HeaderData& header, std::string newHeader, bool makeBackup, const Clock& clock,
                        Dialogs& dialogs, FolderSweeps* sweeps)
{
    FileSaveResult result;
    try {
        // The backup stands beside the file that is written, which is not the link's folder.
        const auto target = ResolveLinks(header.FilePath);
        RestoreInterruptedSaveOf(target, dialogs, sweeps);
        auto options = backupOptions(target, makeBackup, clock);
        options.expected = header.ReadStamp;
        options.sweeps = sweeps;
        // Another program's changes since the file was read are only overwritten when the user says
        // so, whether they came before the save began or while it wrote.
        const auto pieces = SavedPieces(header, newHeader);
        bool changed = header.ReadStamp && StampOfPath(target) != *header.ReadStamp;
        for (;;) {
            if (changed) {
                if (dialogs.message(changedOnDiskBox(header.FilePath)) != Answer::Yes)
                    return result;
                options.expected = StampOfPath(target);
            }
            try {
                result.backupPath =
                    ReplaceFileSafely(target, {pieces[0], pieces[1], pieces[2], pieces[3]}, options).backupPath;
                break;
            } catch (const FileChangedError&) {
                changed = true;
            }
        }
        header.ReadStamp = StampOfPath(target);
        header.HeaderAtOpenOrSave = std::move(newHeader);
        header.BodyChanged = false;
        header.FileChanged = false;
        result.saved = true;
    } catch (const QmError& error) {
        ReportError(dialogs, error, FileSaveProcedure);
    }
    return result;
}
