// SPDX-License-Identifier: MIT
#include "CheckCommands.h"

#include <cerrno>
#include <cstring>
#include <filesystem>
#include <map>
#include <mutex>
#include <nlohmann/json.hpp>
#include <sstream>
#include <unistd.h>

#include "Batch.h"
#include "CheckConfig.h"
#include "CheckOutput.h"
#include "CliFiles.h"
#include "Clock.h"
#include "ColourSource.h"
#include "Composer.h"
#include "ConsoleDialogs.h"
#include "DryRunDiff.h"
#include "EditCommandLine.h"
#include "FieldsJson.h"
#include "FileSave.h"
#include "HeaderEdits.h"
#include "ListFolder.h"
#include "NewFile.h"
#include "PartFile.h"
#include "PartFileList.h"
#include "PartSettings.h"
#include "Paths.h"
#include "QmError.h"
#include "SarifLog.h"
#include "Summary.h"
#include "Text.h"
#include "TrackerCheck.h"

namespace {

std::string firstLine(const std::string& text) { return text.substr(0, text.find('\r')); }

void noteFindings(FileReport& report, const SaveFindings& findings)
{
    for (const auto& refusal : findings.refusals)
        report.refusals.push_back(firstLine(refusal));
    report.missingUserName = findings.missingUserName;
    report.fixups = findings.fixups;
}

// Why a save failed, in the words of the "failed" line.
std::string failureText(const ConsoleDialogs& dialogs)
{
    const auto& title = dialogs.lastTitle();
    if (title == ChangedOnDiskTitle)
        return "changed while saving";
    if (title == FileLockedTitle)
        return "locked by another program";
    if (title == InterruptedTitle)
        return "interrupted";
    if (title == KeptCopyTitle)
        return "an interrupted save was not restored";
    return OneLine(dialogs.lastMessage());
}

// Saves of one file never run at the same time, even when it is named twice or by two of its
// hard links: the second opens after the first saved, or sees its save as a change.
class FileLocks {
public:
    std::mutex& of(const OpenPart& part)
    {
        const auto status = part.status();
        const std::lock_guard lock(mutex_);
        return locks_[{status.st_dev, status.st_ino}];
    }

private:
    std::mutex mutex_;
    std::map<std::pair<dev_t, ino_t>, std::mutex> locks_;
};

// How a command works on its files: one that writes holds each file's lock from its open to its
// save and undoes first what a killed save left (run); one that only reads writes nothing.
struct Writing {
    const ReplaceOptions& run;
    FileLocks& locks;
};

// Opens the file an entry names and lets handle fill the report; an unreadable file is reported
// as such, and so is one that does not fit in memory beside those that the other threads hold.
// Quiet, the messages of the file's dialogs are not shown.
FileReport reportOn(const PartFileEntry& entry, bool quiet, ConsoleDialogs::Answerer answerer, const Writing* writing,
                    RunReads& reads, const std::function<void(HeaderData&, ConsoleDialogs&, FileReport&)>& handle)
{
    FileReport report;
    std::ostringstream err, discarded;
    ConsoleDialogs dialogs(quiet ? discarded : err, std::move(answerer));
    const auto unreadable = [&](const std::exception& failure) {
        ReportUnreadable(entry.path, failure, err);
        report = FileReport{};
        report.unreadable = true;
        report.status = ExitStatus::Unreadable;
    };
    try {
        auto part = OpenEntry(entry);
        const auto held = reads.memory.claim(static_cast<std::size_t>(part->status().st_size));
        std::unique_lock<std::mutex> turn;
        if (writing != nullptr) {
            turn = std::unique_lock(writing->locks.of(*part));
            // Another name of the file was saved meanwhile: this one reads what that save wrote.
            if (!part->stillNamed())
                part = OpenEntry(entry);
        }
        auto opened =
            ReadForCli(part, entry.path, dialogs, err, writing ? &writing->run : nullptr, report.status, reads);
        if (opened)
            handle(*opened, dialogs, report);
        else if (report.status == ExitStatus::Unreadable)
            report.unreadable = true;
        else {
            report.saving = FileReport::Saving::Failed;
            report.out = "failed " + ShownText(entry.path) + ": " + failureText(dialogs) + '\n';
        }
    } catch (const std::exception& failure) {
        unreadable(failure);
    }
    report.err.insert(0, err.str());
    return report;
}

std::string noteLines(const std::string& path, const std::vector<std::string>& notes)
{
    std::string lines;
    for (const auto& note : notes)
        lines += ShownText(path) + ": " + note + '\n';
    return lines;
}

std::string outputClosedText(int error)
{
    const char* name = ::strerrorname_np(error);
    return std::string("standard output closed (") + (name != nullptr ? name : "error") + ")";
}

// writeOut, when given, writes each file's standard output instead of out.
int runBatch(const std::vector<std::string>& arguments, const BatchOptions& batch, std::ostream& out, std::ostream& err,
             const std::function<FileReport(const PartFileEntry&)>& work,
             const std::function<void(const std::string&)>& writeOut = {})
{
    const auto found = ExpandPartFiles(arguments);
    const auto& files = found.files;
    for (const auto& problem : found.problems)
        err << "quillmark-cli: cannot read folder " << ShownText(problem.path) << ": " << problem.reason << '\n';
    for (const auto& keep : found.orphanKeepFiles)
        err << "quillmark-cli: " << ShownText(OrphanCopyNotice(keep)) << '\n';
    Summary summary;
    summary.addWalks(found);
    int status = found.problems.empty() ? ExitStatus::Ok : ExitStatus::Unreadable;
    int outputError = 0;
    const bool whole = RunInOrder(
        files.size(), ThreadsFor(batch.threads), [&](std::size_t index) { return work(files[index]); },
        [&](FileReport& report) {
            if (writeOut)
                writeOut(report.out);
            else
                out << report.out;
            err << report.err;
            summary.add(report);
            status = std::max(status, report.status);
            if (out || outputError != 0)
                return true;
            outputError = errno;
            return false;
        },
        batch.errIsTerminal && !batch.quiet ? &err : nullptr);
    // A signal during the last file ends the run as one between two files does.
    if (!whole || InterruptPending()) {
        // A reader that went away (quillmark-cli save ... | head) or Ctrl+C ends the run between files.
        err << "quillmark-cli: " << (outputError != 0 ? outputClosedText(outputError) : "interrupted")
            << "; the run ends here\n";
        status = std::max(status, ExitStatus::SaveFailed);
    }
    if (!batch.quiet)
        summary.print(err);
    return status;
}

std::string savedLine(const std::string& filePath, const SaveOptions& options, const SaveResult& result,
                      ConsoleDialogs& dialogs, FileReport& report)
{
    const auto path = ShownText(filePath);
    switch (result.outcome) {
    case SaveOutcome::Saved:
        report.saving = FileReport::Saving::Saved;
        return "saved " + path + (options.backup ? " (backup: " + ShownText(result.backupPath) + ")" : " (no backup)") +
               '\n';
    case SaveOutcome::Unchanged: report.saving = FileReport::Saving::Unchanged; return "unchanged " + path + '\n';
    case SaveOutcome::NotWritten: report.saving = FileReport::Saving::Previewed; return {};
    case SaveOutcome::Declined:
        report.saving = FileReport::Saving::Skipped;
        report.status = ExitStatus::Refused;
        return "skipped " + path + ": no user name set\n";
    case SaveOutcome::Failed:
        report.saving = FileReport::Saving::Failed;
        report.status = ExitStatus::SaveFailed;
        return "failed " + path + ": " + failureText(dialogs) + '\n';
    case SaveOutcome::Refused:
    case SaveOutcome::DescriptionTooLong: break;
    }
    report.saving = FileReport::Saving::Skipped;
    report.status = ExitStatus::Refused;
    report.refusals.push_back(firstLine(dialogs.lastMessage()));
    return "skipped " + path + ": " + OneLine(firstLine(dialogs.lastMessage())) + '\n';
}

} // namespace

int RunCheck(const std::vector<std::string>& arguments, const CheckOptions& options, const BatchOptions& batch,
             std::ostream& out, std::ostream& err)
{
    StringList categories;
    std::unique_ptr<ColourSource> colours;
    if (options.tracker && (!ReadStandardList(ListKind::Category, categories, err) ||
                            !(colours = ColourSourceFor(options.settings.ldconfig, err))))
        return ExitStatus::Unreadable;
    CheckConfigs configs(options.config, !options.isolated);
    // A wrong config named on the command line is a wrong command line: no file is read.
    if (const auto named = options.config.empty() ? CheckConfigs::Found{} : configs.forPart(options.config);
        named.error != nullptr) {
        err << "quillmark-cli: " << *named.error << '\n';
        return ExitStatus::Usage;
    }
    std::error_code noFolder;
    const OutputForm form{options.format, options.format == OutputFormat::Github
                                              ? GithubBaseFolder()
                                              : std::filesystem::current_path(noFolder).string()};
    std::optional<SarifLogWriter> sarif;
    if (options.format == OutputFormat::Sarif)
        sarif.emplace(out, form.base);
    RunReads reads;
    const auto checkOne = [&](const HeaderData& header, const PartSettings& settings, ConsoleDialogs& dialogs,
                              FileReport& report) {
        const auto check =
            CheckRecord(header, settings, {options.tracker ? &categories : nullptr, colours.get()}, dialogs);
        const auto& file = check.file;
        // The file is read again only for findings with a place in it.
        const auto bytes = HasPlacedFindings(file) ? FileBytes(*header.Part).takeBytes() : std::string();
        const auto findings = PlacedFindings(check, header, bytes);
        report.out = CheckOutput(form, header, file, findings);
        noteFindings(report, file.save);
        for (const auto& finding : file.tracker)
            report.trackerIds.push_back(finding.id);
        report.refused = std::any_of(findings.begin(), findings.end(), [&](const FileFinding& finding) {
            return settings.choice.fails(finding.severity);
        });
        report.status = report.refused ? ExitStatus::Refused : ExitStatus::Ok;
    };
    const auto status = runBatch(
        arguments, batch, out, err,
        [&](const PartFileEntry& entry) {
            const auto partPath = AbsolutePath(entry.path);
            const auto config = configs.forPart(partPath);
            if (config.error != nullptr) {
                FileReport report;
                report.status = ExitStatus::Usage;
                report.unreadable = true;
                if (config.firstTold)
                    report.err = "quillmark-cli: " + *config.error + '\n';
                return report;
            }
            const auto settings = SettingsForPart(options.settings, config.config, partPath);
            // A check never writes, not even to undo what a killed save left: the next save does that.
            return reportOn(entry, batch.quiet, {}, nullptr, reads,
                            [&](const HeaderData& header, ConsoleDialogs& dialogs, FileReport& report) {
                                checkOne(header, settings, dialogs, report);
                            });
        },
        sarif ? [&sarif](const std::string& text) { sarif->write(text); } : std::function<void(const std::string&)>{});
    if (sarif)
        sarif->finish();
    return status;
}

int RunSave(const std::vector<std::string>& arguments, const SaveOptions& options, const BatchOptions& batch,
            std::ostream& out, std::ostream& err)
{
    return RunEdit(arguments, options, {}, batch, out, err);
}

namespace {

// What the commands that write share over one run: the answers to a save's questions, the clock,
// the locks and sweeps of the files, what the reads share and the files diffed.
struct WritingRun {
    explicit WritingRun(const SaveOptions& options, const BatchOptions& batch)
        : answer([&options](const MessageBox& box) {
              // Another program's changes since the file was read are never overwritten from here.
              if (box.title == ChangedOnDiskTitle)
                  return Answer::No;
              const bool userNameQuestion = box.title == MissingUserNameTitle;
              return (userNameQuestion ? options.allowMissingUserName : options.fix) ? Answer::Yes : Answer::No;
          })
    {
        run.sweeps = &sweeps;
        run.lockWait.interrupted = InterruptPending;
        if (!batch.quiet)
            run.lockWait.waiting = [](const std::string& path) {
                // Said at once, not when the file's turn in the output comes: the run may wait long.
                const auto line = "quillmark-cli: waiting for " + ShownText(path) + ": another program holds it\n";
                [[maybe_unused]] const auto written = ::write(STDERR_FILENO, line.data(), line.size());
            };
    }
    WritingRun(const WritingRun&) = delete;

    ConsoleDialogs::Answerer answer;
    const SystemClock clock;
    FileLocks locks;
    FolderSweeps sweeps;
    ReplaceOptions run;
    const Writing writing{run, locks};
    RunReads reads;
    DiffedFiles diffed;
};

// The edits in the file's encoding; nullopt when a value has no bytes there, the file then failed
// and said so on said.
std::optional<HeaderEdits> editsForFile(const HeaderEdits& edits, const HeaderData& header, const std::string& path,
                                        std::string& said, FileReport& report)
{
    auto encoded = edits;
    if (const auto unwritable = EncodeHeaderEdits(encoded, header.Encoding)) {
        report.saving = FileReport::Saving::Failed;
        report.status = ExitStatus::SaveFailed;
        said = "failed " + ShownText(path) + ": \"" + ShownText(*unwritable) +
               "\" cannot be written in this file's encoding (ISO-8859-1)\n";
        return std::nullopt;
    }
    return encoded;
}

using FileHandler = std::function<void(HeaderData&, ConsoleDialogs&, FileReport&)>;

// Runs handle on each file, which it may write unless writes is off; the header edits asked for
// are made first, and a file they refuse is skipped.
int runWriting(const std::vector<std::string>& arguments, WritingRun& writing, bool writes, const EditOptions& edit,
               const BatchOptions& batch, std::ostream& out, std::ostream& err, const FileHandler& handle)
{
    return runBatch(arguments, batch, out, err, [&](const PartFileEntry& entry) {
        return reportOn(entry, batch.quiet, writing.answer, writes ? &writing.writing : nullptr, writing.reads,
                        [&](HeaderData& header, ConsoleDialogs& dialogs, FileReport& report) {
                            // A dry run prints a diff and only a diff on standard output.
                            auto& said = edit.dryRun ? report.err : report.out;
                            const auto edits = editsForFile(edit.edits, header, entry.path, said, report);
                            if (!edits)
                                return;
                            if (const auto refusal = ApplyHeaderEdits(header, *edits, writing.clock.now())) {
                                report.saving = FileReport::Saving::Skipped;
                                report.status = ExitStatus::Refused;
                                said = "skipped " + ShownText(entry.path) + ": " + *refusal + '\n';
                                return;
                            }
                            handle(header, dialogs, report);
                        });
    });
}

} // namespace

int RunEdit(const std::vector<std::string>& arguments, const SaveOptions& options, EditOptions edit,
            const BatchOptions& batch, std::ostream& out, std::ostream& err)
{
    if (!EditsValid(edit.edits, err))
        return ExitStatus::Usage;
    WritingRun writing(options, batch);
    // A dry run and a JSON listing write nothing.
    const bool writes = !edit.dryRun && !edit.json;
    return runWriting(
        arguments, writing, writes, edit, batch, out, err,
        [&](HeaderData& header, ConsoleDialogs& dialogs, FileReport& report) {
            const auto& path = header.FilePath;
            // A dry run prints a diff and only a diff on standard output.
            auto& said = edit.dryRun ? report.err : report.out;
            const auto notes = edit.afterEdits ? edit.afterEdits(header) : std::vector<std::string>{};
            if (edit.json) {
                const auto findings = EvaluateSaveChecks(header, batch.limitDescription);
                auto json = CheckJson(header, findings);
                json["old_header"] = HeaderTextForJson(header.OldHeader, header.Encoding);
                json["new_header"] = HeaderTextForJson(ComposeHeader(header), header.Encoding);
                if (edit.afterEdits) {
                    auto& notesJson = json["notes"] = nlohmann::ordered_json::array();
                    for (const auto& note : notes)
                        notesJson.push_back(HeaderTextForJson(note, header.Encoding));
                }
                report.out = json.dump() + '\n';
                noteFindings(report, findings);
                report.status = findings.refusals.empty() ? ExitStatus::Ok : ExitStatus::Refused;
                return;
            }
            // Nothing a save writes or says comes from the old header: its memory goes back before
            // the new header is composed, so that a header of millions of lines is not held thrice.
            header.OldHeader.clear();
            header.OldHeader.shrink_to_fit();
            const SaveContext context{.dialogs = dialogs,
                                      .clock = writing.clock,
                                      .makeBackup = options.backup,
                                      .newHeader = [&header] { return ComposeHeader(header); },
                                      .recompose = [] {},
                                      .limitDescription = batch.limitDescription,
                                      .skipUnchanged = true,
                                      .dryRun = edit.dryRun,
                                      .run = writing.run};
            const auto result = CheckHeaderAndSave(header, context);
            const auto line = savedLine(header.FilePath, options, result, dialogs, report);
            said += noteLines(path, notes);
            if (edit.dryRun && (result.outcome == SaveOutcome::NotWritten || result.outcome == SaveOutcome::Unchanged))
                report.out = DryRunDiff(path, FileBytes(*header.Part, {}, &writing.reads.memory).view(),
                                        SavedText(header, ComposeHeader(header)), writing.diffed, report.err);
            else
                said += line;
        });
}

int RunRepair(const std::vector<std::string>& arguments, const SaveOptions& options, const EditOptions& edit,
              const BatchOptions& batch, std::ostream& out, std::ostream& err, const Repairer& repair)
{
    if (!EditsValid(edit.edits, err))
        return ExitStatus::Usage;
    WritingRun writing(options, batch);
    const bool writes = !edit.dryRun && !edit.json;
    return runWriting(
        arguments, writing, writes, {.edits = {}, .dryRun = edit.dryRun, .json = edit.json, .afterEdits = {}}, batch,
        out, err, [&](HeaderData& header, ConsoleDialogs& dialogs, FileReport& report) {
            const auto& path = header.FilePath;
            auto& said = edit.dryRun ? report.err : report.out;
            // The record as read, without the body, which no header edit changes.
            auto body = std::move(header.Body);
            const HeaderData read = header;
            header.Body = std::move(body);
            const auto edits = editsForFile(edit.edits, header, path, said, report);
            if (!edits)
                return;
            if (const auto refusal = ApplyHeaderEdits(header, *edits, writing.clock.now())) {
                report.saving = FileReport::Saving::Skipped;
                report.status = ExitStatus::Refused;
                said = "skipped " + ShownText(path) + ": " + *refusal + '\n';
                return;
            }
            const auto bytes = FileBytes(*header.Part, {}, &writing.reads.memory).takeBytes();
            const auto repaired = repair(bytes, read, header);
            if (!repaired.left.empty()) {
                report.saving = FileReport::Saving::Skipped;
                report.status = ExitStatus::Refused;
                said = "left " + ShownText(path) + ": " + OneLine(repaired.left) + '\n';
                return;
            }
            const auto after = ApplyEdits(bytes, repaired.edits);
            if (edit.json) {
                nlohmann::ordered_json json;
                json["FilePath"] = TextForJson(path);
                auto& edits = json["edits"] = nlohmann::ordered_json::array();
                for (const auto& change : repaired.edits)
                    edits.push_back({{"begin", change.begin},
                                     {"end", change.end},
                                     {"replacement", HeaderTextForJson(change.replacement, header.Encoding)}});
                auto& notes = json["notes"] = nlohmann::ordered_json::array();
                for (const auto& note : repaired.notes)
                    notes.push_back(HeaderTextForJson(note, header.Encoding));
                report.out = json.dump() + '\n';
                return;
            }
            said += noteLines(path, repaired.notes);
            if (after == bytes) {
                report.saving = FileReport::Saving::Unchanged;
                said += "unchanged " + ShownText(path) + '\n';
            } else if (edit.dryRun) {
                report.saving = FileReport::Saving::Previewed;
                report.out = DryRunDiff(path, bytes, after, writing.diffed, report.err);
            } else {
                const auto result = FileSaveText(header, after, options.backup, writing.clock, dialogs, writing.run);
                said += savedLine(path, options,
                                  {result.saved ? SaveOutcome::Saved : SaveOutcome::Failed, result.backupPath}, dialogs,
                                  report);
            }
        });
}
