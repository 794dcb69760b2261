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

// True when the file at FilePath is still as it was read, or when the user, asked, wants to
// overwrite the other program's changes anyway.
bool mayOverwrite(const HeaderData& header, Dialogs& dialogs)
{
    if (!header.ReadStamp || StampOfPath(header.FilePath) == *header.ReadStamp)
        return true;
    return dialogs.message(changedOnDiskBox(header.FilePath)) == Answer::Yes;
}

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

FileSaveResult FileSave(HeaderData& header, const std::string& newHeader, bool makeBackup, const Clock& clock,
                        Dialogs& dialogs)
{
    FileSaveResult result;
    if (!mayOverwrite(header, dialogs))
        return result;
    try {
        // The backup stands beside the file that is written, which is not the link's folder.
        const auto target = ResolveLinks(header.FilePath);
        std::optional<std::string> backupPath;
        if (makeBackup)
            backupPath = MakeBackupName(target, clock.now());
        ReplaceFileSafely(target, {TextBeforeHeader(header), newHeader, header.Body, CrLf}, backupPath);
        header.ReadStamp = StampOfPath(target);
        header.HeaderAtOpenOrSave = newHeader;
        header.FileChanged = false;
        result.saved = true;
        result.backupPath = backupPath.value_or(std::string());
    } catch (const QmError& error) {
        ReportError(dialogs, error, FileSaveProcedure);
    }
    return result;
}
