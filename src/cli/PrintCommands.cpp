// SPDX-License-Identifier: MIT
#include "PrintCommands.h"

#include "CliFiles.h"
#include "Composer.h"
#include "FieldsJson.h"
#include "FileSave.h"
#include "Text.h"

int RunFields(const std::vector<std::string>& paths, ConsoleDialogs& dialogs, std::ostream& out, std::ostream& err)
{
    return ForEachOpenedFile(paths, dialogs, err, [&out](HeaderData& header) {
        out << FieldsJson(header) << '\n';
        return ExitStatus::Ok;
    });
}

int RunPrint(const std::string& path, ConsoleDialogs& dialogs, std::ostream& out, std::ostream& err)
{
    return ForEachOpenedFile({path}, dialogs, err, [&out](HeaderData& header) {
        const auto newHeader = ComposeHeader(header);
        for (const auto piece : SavedPieces(header, newHeader))
            out.write(piece.data(), static_cast<std::streamsize>(piece.size()));
        return ExitStatus::Ok;
    });
}
