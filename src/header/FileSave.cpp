// SPDX-License-Identifier: MIT
#include "FileSave.h"

#include <cstdio>
#include <optional>

#include "Dialogs.h"
#include "ErrorReport.h"
#include "Folders.h"
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
    return {"The file " + path + " was changed by another program after it was opened.\r\n" +
                Translatable("Messages", "Save anyway and overwrite those changes?"),
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

RestoreOutcome RestoreInterruptedSaveOf(const OpenPart& part, Dialogs& dialogs, const ReplaceOptions& run)
{
    try {
        if (!RestoreInterruptedSave(part, run.sweeps, run.lockWait, run.home))
            return RestoreOutcome::NothingToDo;
    } catch (const KeepNotRestoredError& kept) {
        dialogs.message({kept.description(), KeptCopyTitle, Buttons::Ok, Icon::Exclamation, Answer::Ok});
        return RestoreOutcome::CopyKept;
    }
    dialogs.message({"restored " + part.path() + " from an interrupted save", "Quillmark", Buttons::Ok,
                     Icon::Information, Answer::Ok});
    return RestoreOutcome::Restored;
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
    return header.Part && header.ReadStamp && header.Part->unchangedSince(*header.ReadStamp) &&
           FileHoldsExactly(header.Part->fd(), SavedPieces(header, newHeader));
}

namespace {

// Where the part is written: the folder and name it was read from, or where FilePath leads.
struct PartPlace {
    std::shared_ptr<const OpenFolder> folder;
    std::string name, path;
};

PartPlace placeOf(const HeaderData& header)
{
    if (header.Part)
        return {header.Part->sharedFolder(), header.Part->name(), header.Part->path()};
    const auto target = ResolveLinks(header.FilePath);
    return {OpenFolder::open(FolderOf(target), target), target.substr(target.rfind('/') + 1), target};
}

// The file that has the part's name now, after another program replaced or removed the one
// read; null when there is none.
std::shared_ptr<OpenPart> fileNamedNow(const PartPlace& place)
{
    try {
        return OpenPart::openIn(place.folder, place.name, place.path);
    } catch (const QmError& error) {
        if (error.number() == ErrorNumber::FileNotFound)
            return nullptr;
        throw;
    }
}

// The box that says why the save stopped, for the failures that have one of their own.
std::optional<MessageBox> boxFor(const QmError& error)
{
    const auto box = [&error](const char* title) {
        return MessageBox{error.description(), title, Buttons::Ok, Icon::Exclamation, Answer::Ok};
    };
    if (dynamic_cast<const KeepNotRestoredError*>(&error) != nullptr)
        return box(KeptCopyTitle);
    if (dynamic_cast<const FileLockedError*>(&error) != nullptr)
        return box(FileLockedTitle);
    if (dynamic_cast<const InterruptedError*>(&error) != nullptr)
        return box(InterruptedTitle);
    return std::nullopt;
}

// Writes the pieces over the part, or as a new file where the part is gone; asks before
// overwriting another program's change. False when the user would not overwrite it.
bool replaceAsked(HeaderData& header, std::initializer_list<std::string_view> text, ReplaceOptions options,
                  Dialogs& dialogs, FileSaveResult& result)
{
    const auto place = placeOf(header);
    auto part = header.Part ? header.Part : fileNamedNow(place);
    bool changed = header.ReadStamp && !(part && part->unchangedSince(*header.ReadStamp));
    options.expected = header.ReadStamp;
    for (;;) {
        if (changed) {
            if (dialogs.message(changedOnDiskBox(header.FilePath)) != Answer::Yes)
                return false;
            part = fileNamedNow(place);
            options.expected = part ? std::optional(part->stamp()) : std::nullopt;
        }
        try {
            auto replaced =
                part ? ReplacePart(part, text, options) : CreateFileIn(place.folder, place.name, place.path, text);
            result.backupPath = std::move(replaced.backupPath);
            header.Part = replaced.written ? std::move(replaced.written) : fileNamedNow(place);
            return true;
        } catch (const FileChangedError&) {
            changed = true;
        }
    }
}

// Writes text over the part as FileSave says; false when it was not written.
bool saveText(HeaderData& header, std::initializer_list<std::string_view> text, bool makeBackup, const Clock& clock,
              Dialogs& dialogs, const ReplaceOptions& run, FileSaveResult& result)
{
    try {
        // The backup stands beside the file that is written, which is not the link's folder.
        const auto target = header.Part ? header.Part->path() : ResolveLinks(header.FilePath);
        auto options = backupOptions(target, makeBackup, clock);
        options.sweeps = run.sweeps;
        options.lockWait = run.lockWait;
        options.home = run.home;
        options.afterStep = run.afterStep;
        if (!replaceAsked(header, text, options, dialogs, result))
            return false;
        header.ReadStamp = header.Part ? std::optional(header.Part->stamp()) : std::nullopt;
        header.BodyChanged = false;
        header.FileChanged = false;
        result.saved = true;
    } catch (const QmError& error) {
        if (const auto box = boxFor(error))
            dialogs.message(*box);
        else
            ReportError(dialogs, error, FileSaveProcedure);
    }
    return result.saved;
}

} // namespace

FileSaveResult FileSave(HeaderData& header, std::string newHeader, bool makeBackup, const Clock& clock,
                        Dialogs& dialogs, const ReplaceOptions& run)
{
    FileSaveResult result;
    const auto pieces = SavedPieces(header, newHeader);
    if (saveText(header, {pieces[0], pieces[1], pieces[2], pieces[3]}, makeBackup, clock, dialogs, run, result))
        header.HeaderAtOpenOrSave = std::move(newHeader);
    return result;
}

FileSaveResult FileSaveText(HeaderData& header, std::string_view text, bool makeBackup, const Clock& clock,
                            Dialogs& dialogs, const ReplaceOptions& run)
{
    FileSaveResult result;
    saveText(header, {text}, makeBackup, clock, dialogs, run, result);
    return result;
}
