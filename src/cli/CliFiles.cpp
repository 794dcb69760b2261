// SPDX-License-Identifier: MIT
#include "CliFiles.h"

#include <algorithm>
#include <filesystem>

#include "ColourSource.h"
#include "ConsoleDialogs.h"
#include "FileSave.h"
#include "KeepFile.h"
#include "ListFolder.h"
#include "OpenDocument.h"
#include "ParseProgress.h"
#include "PartFile.h"
#include "QmError.h"
#include "StandardLists.h"
#include "TextFile.h"

void ReportUnreadable(const std::string& path, const std::exception& failure, std::ostream& err)
{
    if (dynamic_cast<const NotTextFileError*>(&failure) != nullptr) {
        err << "quillmark-cli: " << ShownText(failure.what()) << '\n'; // it names the file itself
        return;
    }
    err << "quillmark-cli: cannot read " << ShownText(path) << ": " << OneLine(ErrorOf(failure).description()) << '\n';
}

namespace {

// A failure while working on one file (running out of memory, say) ends that file, not the run.
int handleCatching(const std::string& path, HeaderData& header, std::ostream& err,
                   const std::function<int(HeaderData&)>& handle)
{
    try {
        return handle(header);
    } catch (const std::exception& failure) {
        ReportUnreadable(path, failure, err);
        return ExitStatus::Unreadable;
    }
}

} // namespace

namespace {

// The bytes a read-only command reports a part from: those an interrupted save's restore would
// give it, said on err; none when the part is as its last save left it.
std::optional<std::string> bytesAfterRestore(const OpenPart& part, const std::string& path, std::ostream& err,
                                             const KeepSearch& keeps)
{
    const auto finding = keeps.examine(part);
    if (finding.state == KeepFinding::State::Restorable) {
        err << ShownText(path) << ": an interrupted save will be restored by the next save\n";
        return finding.oldBytes;
    }
    if (finding.state == KeepFinding::State::Changed)
        err << OneLine(KeepNotRestoredError(path, finding.keepPath).description()) << '\n';
    if (finding.state == KeepFinding::State::OthersCopy)
        err << OneLine(OthersCopyNotice(path, finding)) << '\n';
    if (finding.state == KeepFinding::State::Orphan)
        err << ShownText(path) << ": " << OneLine(OrphanCopyNotice(finding.keepPath)) << '\n';
    return std::nullopt;
}

} // namespace

std::optional<HeaderData> ReadForCli(const std::shared_ptr<OpenPart>& part, const std::string& path,
                                     ConsoleDialogs& dialogs, std::ostream& err, const ReplaceOptions* writing,
                                     int& status, RunReads& reads)
{
    dialogs.setCurrentFile(path);
    try {
        std::optional<std::string> restored;
        if (writing == nullptr)
            restored = bytesAfterRestore(*part, path, err, reads.keeps);
        else if (RestoreInterruptedSaveOf(*part, dialogs, *writing) == RestoreOutcome::CopyKept) {
            status = ExitStatus::SaveFailed;
            return std::nullopt;
        }
        FileBytes content(*part, TextFileCheck(path), &reads.memory);
        HeaderData header;
        ParseProgress silent;
        OpenPartFileContent(header, path, restored ? std::move(*restored) : content.takeBytes(), dialogs, silent);
        header.Part = part;
        header.ReadStamp = content.stamp();
        return header;
    } catch (const std::exception& failure) {
        ReportUnreadable(path, failure, err);
        status = ExitStatus::Unreadable;
        return std::nullopt;
    }
}

std::optional<HeaderData> OpenForCli(const PartFileEntry& entry, ConsoleDialogs& dialogs, std::ostream& err,
                                     int& status, RunReads& reads)
{
    try {
        return ReadForCli(OpenEntry(entry), entry.path, dialogs, err, nullptr, status, reads);
    } catch (const std::exception& failure) {
        ReportUnreadable(entry.path, failure, err);
        status = ExitStatus::Unreadable;
        return std::nullopt;
    }
}

int ForEachOpenedFile(const std::vector<std::string>& paths, ConsoleDialogs& dialogs, std::ostream& err,
                      const std::function<int(HeaderData&)>& handle)
{
    int status = ExitStatus::Ok;
    RunReads reads;
    for (const auto& path : paths) {
        int opening = ExitStatus::Ok;
        auto opened = OpenForCli({path, nullptr, {}}, dialogs, err, opening, reads);
        status = std::max(status, opened ? handleCatching(path, *opened, err, handle) : opening);
    }
    return status;
}

std::string ProgramFolder()
{
    std::error_code error;
    return std::filesystem::read_symlink("/proc/self/exe", error).parent_path().string();
}

bool ReadStandardList(ListKind kind, StringList& entries, std::ostream& err)
{
    const auto path = ListFilePath(ListFolderOfThisProgram(ProgramFolder()), kind);
    try {
        entries = ReadListFile(path);
        return true;
    } catch (const QmError& failure) {
        err << "quillmark-cli: cannot read the list " << path << ": " << failure.description() << '\n';
        return false;
    }
}

std::unique_ptr<ColourSource> ColourSourceFor(const std::string& ldconfig, std::ostream& err)
{
    const auto path = DataFileOfThisProgram(ProgramFolder(), BuiltInColoursFile);
    try {
        return std::make_unique<ColourSource>(ReadBuiltInColours(path), ldconfig, [&err](const std::string& text) {
            err << "quillmark-cli: " << text << '\n';
        });
    } catch (const QmError& failure) {
        err << "quillmark-cli: cannot read the colour list " << path << ": " << failure.description() << '\n';
        return nullptr;
    }
}
