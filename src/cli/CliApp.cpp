#include "CliApp.h"

#include <CLI/CLI.hpp>

#include "ConsoleDialogs.h"
#include "PrintCommands.h"

int RunCli(int argc, const char* const* argv, std::ostream& out, std::ostream& err)
{
    CLI::App app{"quillmark-cli: reads LDraw part files (*.dat) the way the Quillmark editor opens them."};
    app.name("quillmark-cli");
    app.require_subcommand(1);

    std::vector<std::string> fieldsFiles;
    auto* fields = app.add_subcommand(
        "fields", "Print, per FILE, one JSON line with the header record after opening it (texts as ISO-8859-1).");
    fields->add_option("FILE", fieldsFiles, "Part files to read")->required();

    std::string printFile;
    auto* print = app.add_subcommand(
        "print", "Write to standard output exactly the bytes that saving FILE right after opening it would write.");
    print->add_option("FILE", printFile, "Part file to read")->required();

    try {
        app.parse(argc, argv);
    } catch (const CLI::ParseError& error) {
        return app.exit(error, out, err);
    }

    ConsoleDialogs dialogs(err);
    if (*fields)
        return RunFields(fieldsFiles, dialogs, out, err);
    return RunPrint(printFile, dialogs, out, err);
}
