#include "FileSave.h"

#include <cstdio>

#include "Dialogs.h"
#include "ErrorReport.h"
#include "SafeReplace.h"
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
    const auto trimmed = std::string(TrimBlanks(path));
    if (trimmed.empty())
        return {"", "unbenannt", "txt"};
    const auto slash = trimmed.rfind('/');
    const auto folderWithSlash = slash == std::string::npos ? std::string() : trimmed.substr(0, slash + 1);
    const auto fileName = trimmed.substr(folderWithSlash.size());
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
        return fileName.starts_with(backupMark(name)) && fileName.ends_with("." + name.extension);
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

FileSaveResult FileSave(HeaderData& header, const std::string& newHeader, bool makeBackup, const Clock& clock,
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
        bool changed = header.ReadStamp && StampOfPath(target) != *header.ReadStamp;
        for (;;) {
            if (changed) {
                if (dialogs.message(changedOnDiskBox(header.FilePath)) != Answer::Yes)
                    return result;
                options.expected = StampOfPath(target);
            }
            try {
                result.backupPath =
                    ReplaceFileSafely(target, {TextBeforeHeader(header), newHeader, header.Body, CrLf}, options)
                        .backupPath;
                break;
            } catch (const FileChangedError&) {
                changed = true;
            }
        }
        header.ReadStamp = StampOfPath(target);
        header.FileChanged = false;
        result.saved = true;
    } catch (const QmError& error) {
        ReportError(dialogs, error, FileSaveProcedure);
    }
    return result;
}
