#include "CliFiles.h"

#include <algorithm>

#include "ConsoleDialogs.h"
#include "OpenDocument.h"
#include "ParseProgress.h"
#include "PartFile.h"
#include "QmError.h"

std::optional<HeaderData> OpenForCli(const std::string& path, ConsoleDialogs& dialogs, std::ostream& err)
{
    dialogs.setCurrentFile(path);
    try {
        const FileBytes content(path);
        HeaderData header;
        ParseProgress silent;
        OpenPartFileContent(header, path, content.view(), dialogs, silent);
        return header;
    } catch (const QmError& error) {
        err << "quillmark-cli: cannot read " << path << ": " << error.description() << '\n';
        return std::nullopt;
    }
}

int ForEachOpenedFile(const std::vector<std::string>& paths, ConsoleDialogs& dialogs, std::ostream& err,
                      const std::function<int(HeaderData&)>& handle)
{
    int status = ExitStatus::Ok;
    for (const auto& path : paths) {
        auto header = OpenForCli(path, dialogs, err);
        status = std::max(status, header ? handle(*header) : ExitStatus::Unreadable);
    }
    return status;
}
