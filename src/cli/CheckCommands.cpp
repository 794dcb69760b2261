// SPDX-License-Identifier: MIT
#include "CheckCommands.h"

#include <cerrno>
#include <cstring>
#include <filesystem>
#include <map>
#include <mutex>
#include <nlohmann/json.hpp>
#include <sstream>

#include "Batch.h"
#include "CliFiles.h"
#include "Clock.h"
#include "ColourSource.h"
#include "Composer.h"
#include "ConsoleDialogs.h"
#include "EditCommandLine.h"
#include "FieldsJson.h"
#include "FileSave.h"
#include "HeaderEdits.h"
#include "ListFolder.h"
#include "NewFile.h"
#include "PartFile.h"
#include "PartFileList.h"
#include "QmError.h"
#include "Summary.h"
#include "Text.h"
#include "TrackerCheck.h"
#include "UnifiedDiff.h"

namespace {

using TrackerFindings = std::vector<TrackerFinding>;

// Where the Tracker's colour codes come from; none when the built-in list cannot be read.
std::unique_ptr<ColourSource> colourSource(const std::string& ldconfig, std::ostream& err)
{
    const auto path = DataFileOfThisProgram(ProgramFolder(), BuiltInColoursFile);
    try {
        return std::make_unique<ColourSource>(ReadBuiltInColours(path), ldconfig, [&err](const std::string& text) {
            err << "quillmark-cli: " << text << '\n';
        });
    } catch (const QmError& failure) {
        err << "quillmark-cli: cannot read the colour list " << path << ": " << failure.description() << '\n';
        return nullptr;
    }
}

// "line 12: " before a finding about one line.
std::string linePrefix(const TrackerFinding& finding)
{
    return finding.line > 0 ? "line " + std::to_string(finding.line) + ": " : "";
}

std::string firstLine(const std::string& text) { return text.substr(0, text.find('\r')); }

nlohmann::ordered_json checkJson(const HeaderData& header, const SaveFindings& findings, const TrackerFindings* tracker)
{
    nlohmann::ordered_json json;
    json["FilePath"] = TextForJson(header.FilePath);
    json["refusals"] = findings.refusals;
    json["missing_username"] = findings.missingUserName;
    json["fixups"] = {{"certify_invertnext", findings.fixups.certifyInvertNext},
                      {"rotation", findings.fixups.rotation},
                      {"write", findings.fixups.write},
                      {"color", findings.fixups.color}};
    if (tracker != nullptr) {
        json["tracker"] = nlohmann::ordered_json::array();
        for (const auto& finding : *tracker) {
            auto& entry = json["tracker"].emplace_back(nlohmann::ordered_json{
                {"id", finding.id}, {"level", LevelText(finding.level)}, {"text", finding.text}});
            if (finding.line > 0)
                entry["line"] = finding.line;
        }
    }
    return json;
}

std::string findingLines(const std::string& filePath, const SaveFindings& findings, const TrackerFindings* tracker)
{
    const auto path = ShownText(filePath);
    std::string lines;
    for (const auto& refusal : findings.refusals)
        lines += path + ": refused: " + firstLine(refusal) + '\n';
    if (findings.missingUserName)
        lines += path + ": missing user name\n";
    for (const auto& [offered, what] : FixUpNames(findings.fixups))
        if (offered)
            lines += path + ": fix-up offered: " + what + '\n';
    if (tracker != nullptr)
        for (const auto& finding : *tracker)
            lines += path + ": tracker " + LevelText(finding.level) + " " + finding.id + ": " + linePrefix(finding) +
                     finding.text + '\n';
    return lines.empty() ? path + ": ok\n" : lines;
}

void noteFindings(FileReport& report, const SaveFindings& findings)
{
    for (const auto& refusal : findings.refusals)
        report.refusals.push_back(firstLine(refusal));
    report.missingUserName = findings.missingUserName;
    report.fixups = findings.fixups;
}

// Opens the file at path (see OpenForCli for restoreWith) and lets handle fill the report; an
// unreadable file is reported as such. Quiet, the messages of the file's dialogs are not shown.
FileReport reportOn(const std::string& path, bool quiet, ConsoleDialogs::Answerer answerer, FolderSweeps* restoreWith,
                    const std::function<void(HeaderData&, ConsoleDialogs&, FileReport&)>& handle)
{
    FileReport report;
    std::ostringstream err, discarded;
    ConsoleDialogs dialogs(quiet ? discarded : err, std::move(answerer));
    auto opened = OpenForCli(path, dialogs, err, restoreWith);
    if (!opened) {
        report.unreadable = true;
        report.status = ExitStatus::Unreadable;
    } else {
        try {
            handle(*opened, dialogs, report);
        } catch (const std::exception& failure) {
            ReportUnreadable(path, failure, err);
            report = FileReport{};
            report.unreadable = true;
            report.status = ExitStatus::Unreadable;
        }
    }
    report.err = err.str() + report.err;
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

int runBatch(const std::vector<std::string>& arguments, const BatchOptions& batch, std::ostream& out, std::ostream& err,
             const std::function<FileReport(const std::string&)>& work)
{
    const auto found = ExpandPartFiles(arguments);
    const auto& files = found.files;
    for (const auto& problem : found.problems)
        err << "quillmark-cli: cannot read folder " << ShownText(problem.path) << ": " << problem.reason << '\n';
    Summary summary;
    summary.addWalks(found);
    int status = found.problems.empty() ? ExitStatus::Ok : ExitStatus::Unreadable;
    int outputError = 0;
    const bool whole = RunInOrder(
        files.size(), ThreadsFor(batch.threads), [&](std::size_t index) { return work(files[index]); },
        [&](FileReport& report) {
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
    if (!whole) {
        // A reader that went away (quillmark-cli save ... | head) or Ctrl+C ends the run between files.
        err << "quillmark-cli: " << (outputError != 0 ? outputClosedText(outputError) : "interrupted")
            << "; the run ends here\n";
        status = std::max(status, ExitStatus::SaveFailed);
    }
    if (!batch.quiet)
        summary.print(err);
    return status;
}

// Saves of one file never run at the same time, even when it is named twice.
class FileLocks {
public:
    std::mutex& of(const std::string& path)
    {
        std::error_code error;
        auto key = std::filesystem::weakly_canonical(path, error).string();
        const std::lock_guard lock(mutex_);
        return locks_[error ? path : key];
    }

private:
    std::mutex mutex_;
    std::map<std::string, std::mutex> locks_;
};

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
        return "failed " + path + ": " +
               (dialogs.lastTitle() == ChangedOnDiskTitle ? "changed while saving" : OneLine(dialogs.lastMessage())) +
               '\n';
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
    if (options.tracker &&
        (!ReadStandardList(ListKind::Category, categories, err) || !(colours = colourSource(options.ldconfig, err))))
        return ExitStatus::Unreadable;
    // A check never writes, not even to undo what a killed save left: the next save does that.
    return runBatch(arguments, batch, out, err, [&](const std::string& path) {
        // A check never writes, not even to undo what a killed save left: the next save does that.
        return reportOn(
            path, batch.quiet, {}, nullptr, [&](const HeaderData& header, ConsoleDialogs& dialogs, FileReport& report) {
                const auto findings = EvaluateSaveChecks(header, batch.limitDescription);
                TrackerFindings tracker; // empty unless asked for
                if (options.tracker) {
                    const auto& codes =
                        colours->forPart(path, [&dialogs](const std::string& text) { dialogs.message({text}); });
                    tracker = CheckRecordForTracker(header, ComposeHeader(header), categories, codes);
                }
                const auto* trackerFindings = options.tracker ? &tracker : nullptr;
                report.out = options.json ? checkJson(header, findings, trackerFindings).dump() + '\n'
                                          : findingLines(header.FilePath, findings, trackerFindings);
                noteFindings(report, findings);
                bool trackerRefuses = false;
                for (const auto& finding : tracker) {
                    report.trackerIds.push_back(finding.id);
                    trackerRefuses = trackerRefuses || finding.level == FindingLevel::Error;
                }
                report.refused = trackerRefuses;
                report.status = findings.refusals.empty() && !trackerRefuses ? ExitStatus::Ok : ExitStatus::Refused;
            });
    });
}

int RunSave(const std::vector<std::string>& arguments, const SaveOptions& options, const BatchOptions& batch,
            std::ostream& out, std::ostream& err)
{
    return RunEdit(arguments, options, {}, batch, out, err);
}

int RunEdit(const std::vector<std::string>& arguments, const SaveOptions& options, EditOptions edit,
            const BatchOptions& batch, std::ostream& out, std::ostream& err)
{
    if (!EditsValid(edit.edits, err))
        return ExitStatus::Usage;
    const auto answer = [&options](const MessageBox& box) {
        // Another program's changes since the file was read are never overwritten from here.
        if (box.title == ChangedOnDiskTitle)
            return Answer::No;
        const bool userNameQuestion = box.title == MissingUserNameTitle;
        return (userNameQuestion ? options.allowMissingUserName : options.fix) ? Answer::Yes : Answer::No;
    };
    const SystemClock clock;
    FileLocks locks;
    FolderSweeps sweeps;
    return runBatch(arguments, batch, out, err, [&](const std::string& path) {
        const std::lock_guard lock(locks.of(path));
        return reportOn(path, batch.quiet, answer, edit.dryRun ? nullptr : &sweeps, // a dry run writes nothing
                        [&](HeaderData& header, ConsoleDialogs& dialogs, FileReport& report) {
                            if (const auto refusal = ApplyHeaderEdits(header, edit.edits, clock.now())) {
                                report.saving = FileReport::Saving::Skipped;
                                report.status = ExitStatus::Refused;
                                report.out = "skipped " + ShownText(path) + ": " + *refusal + '\n';
                                return;
                            }
                            const auto notes = edit.afterEdits ? edit.afterEdits(header) : std::vector<std::string>{};
                            if (edit.json) {
                                const auto findings = EvaluateSaveChecks(header, batch.limitDescription);
                                auto json = checkJson(header, findings, nullptr);
                                json["old_header"] = TextForJson(header.OldHeader);
                                json["new_header"] = TextForJson(ComposeHeader(header));
                                if (edit.afterEdits) {
                                    auto& notesJson = json["notes"] = nlohmann::ordered_json::array();
                                    for (const auto& note : notes)
                                        notesJson.push_back(TextForJson(note));
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
                                                      .clock = clock,
                                                      .makeBackup = options.backup,
                                                      .newHeader = [&header] { return ComposeHeader(header); },
                                                      .recompose = [] {},
                                                      .limitDescription = batch.limitDescription,
                                                      .skipUnchanged = true,
                                                      .dryRun = edit.dryRun,
                                                      .sweeps = &sweeps};
                            const auto result = CheckHeaderAndSave(header, context);
                            // A dry run's standard output is a patch and nothing else.
                            (edit.dryRun ? report.err : report.out) += noteLines(path, notes);
                            report.out += savedLine(header.FilePath, options, result, dialogs, report);
                            if (edit.dryRun &&
                                (result.outcome == SaveOutcome::NotWritten || result.outcome == SaveOutcome::Unchanged))
                                report.out =
                                    UnifiedDiff(FileBytes(path).view(), SavedText(header, ComposeHeader(header)), path);
                        });
    });
}
