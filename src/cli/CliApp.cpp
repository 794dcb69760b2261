#include "CliApp.h"

#include <CLI/CLI.hpp>

#include "Batch.h"
#include "CheckCommands.h"
#include "CliFiles.h"
#include "ConsoleDialogs.h"
#include "EditCommandLine.h"
#include "PrintCommands.h"

int RunCli(int argc, const char* const* argv, std::ostream& out, std::ostream& err, bool errIsTerminal)
{
    CLI::App app{"quillmark-cli: reads LDraw part files (*.dat) the way the Quillmark editor opens them."};
    app.name("quillmark-cli");
    app.set_version_flag("--version", std::string("quillmark-cli ") + QUILLMARK_VERSION);
    app.require_subcommand(1);

    std::vector<std::string> fieldsFiles;
    auto* fields = app.add_subcommand(
        "fields", "Print, per FILE, one JSON line with the header record after opening it (texts as ISO-8859-1; "
                  "the two paths as UTF-8 when their bytes are valid UTF-8, else as ISO-8859-1 too).");
    fields->add_option("FILE", fieldsFiles, "Part files to read")->required();

    std::string printFile;
    auto* print = app.add_subcommand(
        "print", "Write to standard output exactly the bytes that saving FILE right after opening it would write.");
    print->add_option("FILE", printFile, "Part file to read")->required();

    BatchOptions batch;
    batch.errIsTerminal = errIsTerminal;
    bool noLengthLimit = false;
    const auto addBatchOptions = [&](CLI::App* command) {
        command->add_flag("--no-length-limit", noLengthLimit, "Allow part descriptions of any length");
        command->add_option("-j,--jobs", batch.threads, "Files worked on at once, 1 to 1024 (default: one per core)")
            ->check(CLI::Range(1u, MaxThreads));
        command->add_flag(
            "--quiet", batch.quiet,
            "Print the line of each file, and only on standard error the files and folders that cannot be "
            "read: no messages, progress or summary");
    };

    std::vector<std::string> checkFiles;
    CheckOptions checkOptions;
    auto* check = app.add_subcommand(
        "check", "Run every save check on each FILE, or each part file (*.dat) below a FOLDER, without writing: "
                 "refusals, a missing user name, and the fix-ups a save would offer; then a summary on standard "
                 "error. Exit status 1 when any file would be refused, 2 when one cannot be read.");
    check->add_flag("--json", checkOptions.json,
                    "One JSON object per file and line. A path is given as UTF-8 when its bytes are valid UTF-8, "
                    "otherwise each byte as the ISO-8859-1 character of that code");
    check->add_flag("--tracker", checkOptions.tracker,
                    "Check the Parts Tracker's header rules too (an error there refuses the file). Rules that need "
                    "the Tracker's database (registered authors, duplicates, held subfiles) are not checked.");
    addBatchOptions(check);
    check->add_option("FILE", checkFiles, "Part files or folders to check")->required();

    std::vector<std::string> saveFiles;
    bool noBackup = false;
    SaveOptions saveOptions;
    const auto addSaveOptions = [&](CLI::App* command) {
        command->add_flag("--no-backup", noBackup, "Do not keep the old file under a dated backup name");
        command->add_flag("--fix", saveOptions.fix, "Apply all four body and colour fix-ups");
        command->add_flag("--allow-missing-username", saveOptions.allowMissingUserName,
                          "Save files whose author line has no user name");
        addBatchOptions(command);
        command->add_option("FILE", saveFiles, "Part files or folders to save")->required();
    };
    auto* save = app.add_subcommand(
        "save", "Re-save each FILE, or each part file below a FOLDER, as the editor's Save does: checked, "
                "optionally fixed, with a dated backup; a file that would stay byte for byte as it is is not "
                "written. Exit status 1 when a file was skipped, 2 when one cannot be read, 3 when a save failed.");
    addSaveOptions(save);

    EditOptions editOptions;
    bool noCategory = false;
    auto* edit = app.add_subcommand(
        "edit", "Change the headers of each FILE, or each part file below a FOLDER, and save them as save does. "
                "Values are the header's own texts; those from a standard list are checked before any file is "
                "read. Exit statuses as for save, and 2 for a value refused up front.");
    AddEditOptions(*edit, editOptions, noCategory);
    addSaveOptions(edit);

    try {
        app.parse(argc, argv);
    } catch (const CLI::ParseError& error) {
        return app.exit(error, out, err) == 0 ? ExitStatus::Ok : ExitStatus::Usage;
    }

    ConsoleDialogs dialogs(err);
    batch.limitDescription = !noLengthLimit;
    if (*fields)
        return RunFields(fieldsFiles, dialogs, out, err);
    if (*check)
        return RunCheck(checkFiles, checkOptions, batch, out, err);
    saveOptions.backup = !noBackup;
    if (*save)
        return RunSave(saveFiles, saveOptions, batch, out, err);
    if (*edit) {
        if (noCategory)
            editOptions.edits.category = "";
        if (editOptions.edits.addHistory)
            editOptions.edits.historyUser = HistoryUser(editOptions.edits.historyUser);
        return RunEdit(saveFiles, saveOptions, editOptions, batch, out, err);
    }
    return RunPrint(printFile, dialogs, out, err);
}
