#include "PrintCommands.h"

#include "CliFiles.h"
#include "Composer.h"
#include "FieldsJson.h"
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
        out.write(newHeader.data(), static_cast<std::streamsize>(newHeader.size()));
        out.write(header.Body.data(), static_cast<std::streamsize>(header.Body.size()));
        out.write(CrLf.data(), static_cast<std::streamsize>(CrLf.size()));
        return ExitStatus::Ok;
    });
}
