// SPDX-License-Identifier: MIT
#include "CliApp.h"

#include <CLI/CLI.hpp>
#include <filesystem>
#include <map>
#include <unistd.h>

#include "Batch.h"
#include "CheckCommands.h"
#include "CliFiles.h"
#include "ClosestWord.h"
#include "ConsoleDialogs.h"
#include "EditCommandLine.h"
#include "ExplainCommand.h"
#include "FixCommand.h"
#include "PrintCommands.h"
#include "RuleChoice.h"

namespace {

constexpr const char* ReadExitStatuses =
    "Exit status:\n  0  every file was read\n  2  a file cannot be read, or the command line is wrong\n";
constexpr const char* SaveExitStatuses =
    "Exit status:\n  0  every file was saved or left as it was\n  1  a file was skipped: refused, or without user "
    "name\n  2  a file or folder cannot be read, or the command line or one of its values is wrong\n  3  a save "
    "failed, or the run was interrupted\n";

// A file named on the command line is read before any part file: one that cannot be is a mistake
// of the command line.
const CLI::Validator ReadableFile(
    [](const std::string& path) {
        std::error_code error;
        if (!std::filesystem::is_regular_file(path, error) || ::access(path.c_str(), R_OK) != 0)
            return "cannot read " + ShownText(path);
        return std::string();
    },
    "FILE");

// The commands, their options and what the options fill.
class CommandLine {
public:
    CommandLine(bool errIsTerminal, LanguageServerStart languageServer) : languageServer_(std::move(languageServer))
    {
        app_.name("quillmark-cli");
        app_.set_version_flag("--version", std::string("quillmark-cli ") + QUILLMARK_VERSION);
        app_.require_subcommand(1);
        batch_.errIsTerminal = errIsTerminal;
        addReadCommands();
        addCheck();
        addExplain();
        addSaveAndEdit();
        if (languageServer_)
            addLsp();
    }

    int run(int argc, const char* const* argv, std::ostream& out, std::ostream& err)
    {
        if (argc > 1 && !knownCommand(argv[1], err))
            return ExitStatus::Usage;
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
            return runCheck(out, err);
        if (*explain_)
            return RunExplain(explainId_, explainMarkdown_, out, err);
        if (*save_)
            return RunSave(files_, saveOptions_, batch_, out, err);
        if (*edit_)
            return RunEdit(files_, saveOptions_, editOptions(), batch_, out, err);
        if (lsp_ != nullptr && *lsp_)
            return languageServer_(checkOptions_.settings.ldconfig, !noLengthLimit_);
        if (*fix_) {
            auto options = saveOptions_;
            options.backup = fixOptions_.recompose ? !noBackup_ : backup_;
            return RunFix(files_, fixOptions_, options, editOptions(), batch_, out, err);
        }
        return RunPrint(printFile_, dialogs, out, err);
    }

private:
    // A word where the command belongs must name one: a typo gets a hint, not a list of options.
    bool knownCommand(std::string_view word, std::ostream& err) const
    {
        if (word.starts_with('-'))
            return true;
        std::vector<std::string> names;
        for (const auto* command : app_.get_subcommands({}))
            names.push_back(command->get_name());
        if (std::find(names.begin(), names.end(), word) != names.end())
            return true;
        err << "quillmark-cli: unknown command '" << ShownText(word) << "'";
        if (const auto closest = ClosestWord(word, names); !closest.empty())
            err << "; did you mean '" << closest << "'?";
        err << "\nRun quillmark-cli --help for the commands.\n";
        return false;
    }

    void addReadCommands()
    {
        fields_ = app_.add_subcommand(
            "fields", "Print, per FILE, one JSON line with the header record after opening it: the texts of a file "
                      "whose bytes are valid UTF-8 as UTF-8, of any other file each byte as the ISO-8859-1 character "
                      "of that code; the two paths likewise, each by its own bytes.");
        fields_->footer(ReadExitStatuses);
        fields_->add_option("FILE", files_, "Part files to read")->required();
        auto* print = app_.add_subcommand(
            "print", "Write to standard output exactly the bytes that saving FILE right after opening it would write.");
        print->add_option("FILE", printFile_, "Part file to read")->required();
        print->footer(ReadExitStatuses);
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
                     "error.");
        check_->footer("Exit status:\n  0  no file would be refused\n  1  a file would be refused, by a save check or "
                       "an error of the Parts Tracker's rules\n  2  a file or folder cannot be read, or the command "
                       "line is wrong\n");
        const std::map<std::string, OutputFormat> formats{{"text", OutputFormat::Text},
                                                          {"json", OutputFormat::Json},
                                                          {"sarif", OutputFormat::Sarif},
                                                          {"github", OutputFormat::Github}};
        auto* format =
            check_
                ->add_option("--format", checkOptions_.format,
                             "text: \"path:line:column: severity: message [id]\" per finding, as compilers write "
                             "them; json: one object per file and line; sarif: one SARIF 2.1.0 log for code scanning; "
                             "github: GitHub Actions annotations")
                ->transform(CLI::CheckedTransformer(formats, CLI::ignore_case))
                ->option_text("text|json|sarif|github");
        check_
            ->add_flag_callback(
                "--json", [this] { checkOptions_.format = OutputFormat::Json; }, "The same as --format json")
            ->excludes(format);
        check_->add_flag("--tracker", checkOptions_.tracker,
                         "Check the Parts Tracker's header and line rules too (an error there refuses the file). "
                         "Rules that need the Tracker's database (registered authors, duplicates, held subfiles) are "
                         "not checked.");
        check_
            ->add_option("--ldconfig", checkOptions_.settings.ldconfig,
                         "The LDConfig.ldr whose colour codes --tracker accepts (default: the first LDConfig.ldr in "
                         "the file's folder or above it, else the built-in list)")
            ->check(ReadableFile);
        check_
            ->add_option("--select", select_,
                         "Report only these rules, by id (a,b); an id ending in \".\" names a group: numbers., save.")
            ->delimiter(',');
        check_->add_option("--ignore", ignore_, "Do not report these rules, by id or group as for --select")
            ->delimiter(',');
        check_
            ->add_option("--fail-on", failOn_,
                         "The findings that make the exit status 1: error (the default), "
                         "warning (warnings too) or never")
            ->check(CLI::IsMember({"error", "warning", "never"}));
        auto* config = check_
                           ->add_option("--config", checkOptions_.config,
                                        "The quillmark.toml for every file (default: the nearest one in the file's "
                                        "folder or above it)")
                           ->check(ReadableFile);
        check_->add_flag("--isolated", checkOptions_.isolated, "Read no quillmark.toml")->excludes(config);
        addBatchOptions(check_);
        check_->add_option("FILE", files_, "Part files or folders to check")->required();
    }

    void addLsp()
    {
        lsp_ = app_.add_subcommand(
            "lsp", "Serve an editor as a language server (LSP 3.17 on standard input and output): the findings of "
                   "check --tracker on each open document while it is edited, hover help for header lines, and "
                   "completion of header values. Nothing is written to disk.");
        lsp_->footer("Exit status:\n  0  the editor shut the server down\n  1  the input ended or exit came "
                     "without shutdown\n  2  a list file cannot be read, or the command line is wrong\n");
        lsp_->add_option("--ldconfig", checkOptions_.settings.ldconfig,
                         "The LDConfig.ldr whose colour codes are accepted (default: the first LDConfig.ldr in the "
                         "document's folder or above it, else the built-in list)")
            ->check(ReadableFile);
        lsp_->add_flag("--no-length-limit", noLengthLimit_, "Allow part descriptions of any length");
        // Editors' set-ups often name the transport; standard input and output is the only one.
        lsp_->add_flag("--stdio")->description("Talk over standard input and output (the default and only way)");
    }

    void addExplain()
    {
        explain_ = app_.add_subcommand("explain", "Print what the rule ID checks, why the library has it, whether "
                                                  "and how a command repairs it, and an example.");
        explain_->footer("Exit status:\n  0  the rule was explained\n  2  no check reports ID, or the command "
                         "line is wrong\n");
        auto* markdown =
            explain_->add_flag("--markdown", explainMarkdown_, "Print every rule as the Markdown page docs/rules.md");
        explain_->add_option("ID", explainId_, "The id of a finding, as check prints it")->excludes(markdown);
    }

    int runCheck(std::ostream& out, std::ostream& err)
    {
        for (const auto* patterns : {&select_, &ignore_})
            if (const auto unknown = UnknownRulePattern(*patterns)) {
                err << "quillmark-cli: " << (patterns == &select_ ? "--select " : "--ignore ") << *unknown << '\n';
                return ExitStatus::Usage;
            }
        auto& given = checkOptions_.settings;
        if (check_->count("--select") > 0)
            given.select = select_;
        if (check_->count("--ignore") > 0)
            given.ignore = ignore_;
        if (!failOn_.empty())
            given.failOn = FailOnNamed(failOn_);
        given.noLengthLimit = noLengthLimit_;
        return RunCheck(files_, checkOptions_, batch_, out, err);
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
                    "written.");
        save_->footer(SaveExitStatuses);
        addSaveOptions(save_);
        edit_ = app_.add_subcommand(
            "edit", "Change the headers of each FILE, or each part file below a FOLDER, and save them as save does. "
                    "Values are the header's own texts; those from a standard list are checked before any file is "
                    "read.");
        edit_->footer(SaveExitStatuses);
        AddEditOptions(*edit_, editOptions_, noCategory_);
        addSaveOptions(edit_);
        fix_ = app_.add_subcommand(
            "fix",
            "Repair in each FILE, or each part file below a FOLDER, the Parts Tracker's findings that have one "
            "correct repair (licence, Name: folder, description numbers, \"Pattern\", retired category, "
            "decimals and zeros of numbers), after edit's changes. Each repair edits the file as it stands: line "
            "ends, blanks and every line without a repaired finding stay byte for byte, and the file is "
            "written through the same safe save as edit's, without a backup unless --backup. Per file, each "
            "repair is named with the lines it changed, and each finding left with why.");
        fix_->footer(SaveExitStatuses);
        fix_->add_option("--only", fixOptions_.only,
                         "Run only these repairs, by the Tracker's ids (a,b); "
                         "line.invalidcoloredlines runs only when named here")
            ->delimiter(',');
        fix_->add_flag("--recompose", fixOptions_.recompose,
                       "Repair the header's record and save the header composed anew, after the save checks, as edit "
                       "saves (with its backup, --no-backup, --fix and --allow-missing-username)");
        fix_->add_flag("--backup", backup_, "Keep the old file under a dated backup name (without --recompose)");
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
    CLI::App *fields_ = nullptr, *check_ = nullptr, *save_ = nullptr, *edit_ = nullptr, *fix_ = nullptr,
             *explain_ = nullptr, *lsp_ = nullptr;
    LanguageServerStart languageServer_;
    std::vector<std::string> files_, select_, ignore_;
    std::string failOn_, explainId_;
    bool explainMarkdown_ = false;
    std::string printFile_;
    BatchOptions batch_;
    bool noLengthLimit_ = false, noBackup_ = false, noCategory_ = false, backup_ = false;
    CheckOptions checkOptions_;
    SaveOptions saveOptions_;
    EditOptions editOptions_;
    FixOptions fixOptions_;
};

} // namespace

int RunCli(int argc, const char* const* argv, std::ostream& out, std::ostream& err, bool errIsTerminal,
           const LanguageServerStart& languageServer)
{
    return CommandLine(errIsTerminal, languageServer).run(argc, argv, out, err);
}
