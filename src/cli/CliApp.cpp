// SPDX-License-Identifier: MIT
#include "CliApp.h"

#include <CLI/CLI.hpp>

#include "Batch.h"
#include "CheckCommands.h"
#include "CliFiles.h"
#include "ConsoleDialogs.h"
#include "EditCommandLine.h"
#include "FixCommand.h"
#include "PrintCommands.h"

namespace {

// The commands, their options and what the options fill.
class CommandLine {
public:
    explicit CommandLine(bool errIsTerminal)
    {
        app_.name("quillmark-cli");
        app_.set_version_flag("--version", std::string("quillmark-cli ") + QUILLMARK_VERSION);
        app_.require_subcommand(1);
        batch_.errIsTerminal = errIsTerminal;
        addReadCommands();
        addCheck();
        addSaveAndEdit();
    }

    int run(int argc, const char* const* argv, std::ostream& out, std::ostream& err)
    {
        try {
            app_.parse(argc, argv);
        } catch (const CLI::ParseError& error) {
            return app_.exit(error, out, err) == 0 ? ExitStatus::Ok : ExitStatus::Usage;
        }
        ConsoleDialogs dialogs(err);
        batch_.limitDescription = !noLengthLimit_;
        saveOptions_.backup = !noBackup_;
        if (*fields_)
            return RunFields(files_, dialogs, out, err);
        if (*check_)
            return RunCheck(files_, checkOptions_, batch_, out, err);
        if (*save_)
            return RunSave(files_, saveOptions_, batch_, out, err);
        if (*edit_)
            return RunEdit(files_, saveOptions_, editOptions(), batch_, out, err);
        if (*fix_)
            return RunFix(files_, only_, saveOptions_, editOptions(), batch_, out, err);
        return RunPrint(printFile_, dialogs, out, err);
    }

private:
    void addReadCommands()
    {
        fields_ = app_.add_subcommand(
            "fields", "Print, per FILE, one JSON line with the header record after opening it (texts as ISO-8859-1; "
                      "the two paths as UTF-8 when their bytes are valid UTF-8, else as ISO-8859-1 too).");
        fields_->add_option("FILE", files_, "Part files to read")->required();
        auto* print = app_.add_subcommand(
            "print", "Write to standard output exactly the bytes that saving FILE right after opening it would write.");
        print->add_option("FILE", printFile_, "Part file to read")->required();
    }

    void addBatchOptions(CLI::App* command)
    {
        command->add_flag("--no-length-limit", noLengthLimit_, "Allow part descriptions of any length");
        command->add_option("-j,--jobs", batch_.threads, "Files worked on at once, 1 to 1024 (default: one per core)")
            ->check(CLI::Range(1u, MaxThreads));
        command->add_flag(
            "--quiet", batch_.quiet,
            "Print the line of each file, and only on standard error the files and folders that cannot be "
            "read: no messages, progress or summary");
    }

    void addCheck()
    {
        check_ = app_.add_subcommand(
            "check", "Run every save check on each FILE, or each part file (*.dat) below a FOLDER, without writing: "
                     "refusals, a missing user name, and the fix-ups a save would offer; then a summary on standard "
                     "error. Exit status 1 when any file would be refused, 2 when one cannot be read.");
        check_->add_flag("--json", checkOptions_.json,
                         "One JSON object per file and line. A path is given as UTF-8 when its bytes are valid UTF-8, "
                         "otherwise each byte as the ISO-8859-1 character of that code");
        check_->add_flag("--tracker", checkOptions_.tracker,
                         "Check the Parts Tracker's header and line rules too (an error there refuses the file). "
                         "Rules that need the Tracker's database (registered authors, duplicates, held subfiles) are "
                         "not checked.");
        check_->add_option("--ldconfig", checkOptions_.ldconfig,
                           "The LDConfig.ldr whose colour codes --tracker accepts (default: the first LDConfig.ldr in "
                           "the file's folder or above it, else the built-in list)");
        addBatchOptions(check_);
        check_->add_option("FILE", files_, "Part files or folders to check")->required();
    }

    void addSaveOptions(CLI::App* command)
    {
        command->add_flag("--no-backup", noBackup_, "Do not keep the old file under a dated backup name");
        command->add_flag("--fix", saveOptions_.fix, "Apply all four body and colour fix-ups");
        command->add_flag("--allow-missing-username", saveOptions_.allowMissingUserName,
                          "Save files whose author line has no user name");
        addBatchOptions(command);
        command->add_option("FILE", files_, "Part files or folders to save")->required();
    }

    void addSaveAndEdit()
    {
        save_ = app_.add_subcommand(
            "save", "Re-save each FILE, or each part file below a FOLDER, as the editor's Save does: checked, "
                    "optionally fixed, with a dated backup; a file that would stay byte for byte as it is is not "
                    "written. Exit status 1 when a file was skipped, 2 when one cannot be read, 3 when a save failed.");
        addSaveOptions(save_);
        edit_ = app_.add_subcommand(
            "edit", "Change the headers of each FILE, or each part file below a FOLDER, and save them as save does. "
                    "Values are the header's own texts; those from a standard list are checked before any file is "
                    "read. Exit statuses as for save, and 2 for a value refused up front.");
        AddEditOptions(*edit_, editOptions_, noCategory_);
        addSaveOptions(edit_);
        fix_ = app_.add_subcommand(
            "fix", "Repair in each FILE, or each part file below a FOLDER, the Parts Tracker's findings that have one "
                   "correct repair (licence, Name: folder, description numbers, \"Pattern\", retired category, "
                   "decimals and zeros of numbers), after edit's changes, and save as edit does. Per file, each "
                   "repair done is named with its count, and each finding left with why. Exit statuses as for edit.");
        fix_->add_option("--only", only_,
                         "Run only these repairs, by the Tracker's ids (a,b); "
                         "line.invalidcoloredlines runs only when named here")
            ->delimiter(',');
        AddEditOptions(*fix_, editOptions_, noCategory_);
        addSaveOptions(fix_);
    }

    EditOptions editOptions() const
    {
        auto options = editOptions_;
        if (noCategory_)
            options.edits.category = "";
        if (options.edits.addHistory)
            options.edits.historyUser = HistoryUser(options.edits.historyUser);
        return options;
    }

    CLI::App app_{"quillmark-cli: reads LDraw part files (*.dat) the way the Quillmark editor opens them."};
    CLI::App *fields_ = nullptr, *check_ = nullptr, *save_ = nullptr, *edit_ = nullptr, *fix_ = nullptr;
    std::vector<std::string> files_, only_;
    std::string printFile_;
    BatchOptions batch_;
    bool noLengthLimit_ = false, noBackup_ = false, noCategory_ = false;
    CheckOptions checkOptions_;
    SaveOptions saveOptions_;
    EditOptions editOptions_;
};

} // namespace

int RunCli(int argc, const char* const* argv, std::ostream& out, std::ostream& err, bool errIsTerminal)
{
    return CommandLine(errIsTerminal).run(argc, argv, out, err);
}
