#include "CliFiles.h"

#include <algorithm>
#include <filesystem>

#include "ConsoleDialogs.h"
#include "ListFolder.h"
#include "OpenDocument.h"
#include "ParseProgress.h"
#include "QmError.h"
#include "StandardLists.h"

void ReportUnreadable(const std::string& path, const std::exception& failure, std::ostream& err)
{
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

std::optional<OpenedPart> OpenForCli(const std::string& path, ConsoleDialogs& dialogs, std::ostream& err)
{
    dialogs.setCurrentFile(path);
    try {
        OpenedPart opened{std::make_unique<FileBytes>(path), {}};
        ParseProgress silent;
        OpenPartFileContent(opened.header, path, opened.content->view(), dialogs, silent);
        opened.header.ReadStamp = opened.content->stamp();
        return opened;
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
        status = std::max(status, opened ? handleCatching(path, opened->header, err, handle) : ExitStatus::Unreadable);
    }
    return status;
}

bool ReadStandardList(ListKind kind, StringList& entries, std::ostream& err)
{
    std::error_code error;
    const auto programFolder = std::filesystem::read_symlink("/proc/self/exe", error).parent_path().string();
    const auto path = ListFilePath(ListFolderOfThisProgram(programFolder), kind);
    try {
        entries = ReadListFile(path);
        return true;
    } catch (const QmError& failure) {
        err << "quillmark-cli: cannot read the list " << path << ": " << failure.description() << '\n';
        return false;
    }
}
