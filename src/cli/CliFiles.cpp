#include "CliFiles.h"

#include <algorithm>

#include "ConsoleDialogs.h"
#include "FileSave.h"
#include "OpenDocument.h"
#include "ParseProgress.h"
#include "PartFile.h"
#include "QmError.h"

void ReportUnreadable(const std::string& path, const std::exception& failure, std::ostream& err)
{
    err << "quillmark-cli: cannot read " << path << ": " << ErrorOf(failure).description() << '\n';
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
        const FileBytes content(path);
        HeaderData header;
        ParseProgress silent;
        OpenPartFileContent(header, path, content.view(), dialogs, silent);
        header.ReadStamp = content.stamp();
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
        auto header = OpenForCli(path, dialogs, err);
        status = std::max(status, header ? handleCatching(path, *header, err, handle) : ExitStatus::Unreadable);
    }
    return status;
}
