// SPDX-License-Identifier: MIT
#include "CliFiles.h"

#include <algorithm>
#include <filesystem>

#include "ConsoleDialogs.h"
#include "FileSave.h"
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

std::optional<HeaderData> OpenForCli(const std::string& path, ConsoleDialogs& dialogs, std::ostream& err,
                                     FolderSweeps* restoreWith)
{
    dialogs.setCurrentFile(path);
    try {
        if (restoreWith != nullptr)
            RestoreInterruptedSaveOf(path, dialogs, restoreWith);
        FileBytes content(path);
        HeaderData header;
        header.ReadStamp = content.stamp();
        ParseProgress silent;
        OpenPartFileContent(header, path, content.takeBytes(), dialogs, silent);
        return header;
    } catch (const std::exception& failure) {
        ReportUnreadable(path, failure, err);
        return std::nullopt;
    }
}

int ForEachOpenedFile(const std::vector<std::string>& paths, ConsoleDialogs& dialogs, std::ostream& err,
                      const std::function<int(HeaderData&)>& handle)
{
    int status = ExitStatus::Ok;
    for (const auto& path : paths) {
        auto opened = OpenForCli(path, dialogs, err);
        status = std::max(status, opened ? handleCatching(path, *opened, err, handle) : ExitStatus::Unreadable);
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
