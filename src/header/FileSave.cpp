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
    std::string folderWithSlash, base = "unbenannt", extension = "txt";
    // Only a blank path is trimmed: the blanks of a real one belong to its file's name.
    if (!TrimBlanks(path).empty()) {
        const auto slash = path.rfind('/');
        folderWithSlash = slash == std::string::npos ? std::string() : path.substr(0, slash + 1);
        const auto fileName = path.substr(folderWithSlash.size());
        const auto dot = fileName.find('.');
        if (dot == std::string::npos)
            throw InvalidCallError();
        base = fileName.substr(0, dot);
        extension = fileName.substr(dot + 1);
    }
    return folderWithSlash + base + "_Backup_" + stampText(stamp) + "." + extension;
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

bool SaveWouldWrite(const HeaderData& header, const std::string& newHeader, std::string_view bytes)
{
    for (const auto piece : SavedPieces(header, newHeader)) {
        if (!bytes.starts_with(piece))
            return false;
        bytes.remove_prefix(piece.size());
    }
    return bytes.empty();
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
        const auto pieces = SavedPieces(header, newHeader);
        ReplaceFileSafely(target, {pieces[0], pieces[1], pieces[2], pieces[3]}, backupPath);
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
