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
#include "Composer.h"
#include "ConsoleDialogs.h"
#include "FileSave.h"
#include "ListFolder.h"
#include "NewFile.h"
#include "PartFileList.h"
#include "QmError.h"
#include "StandardLists.h"
#include "Summary.h"
#include "Text.h"
#include "TrackerCheck.h"

namespace {

using TrackerFindings = std::vector<TrackerFinding>;

// The official categories, from the category list the window uses.
bool readCategories(StringList& categories, std::ostream& err)
{
    std::error_code error;
    const auto programFolder = std::filesystem::read_symlink("/proc/self/exe", error).parent_path().string();
    const auto path = ListFilePath(ListFolderOfThisProgram(programFolder), ListKind::Category);
    try {
        categories = ReadListFile(path);
        return true;
    } catch (const QmError& failure) {
        err << "quillmark-cli: cannot read the category list " << path << ": " << failure.description() << '\n';
        return false;
    }
}

std::string firstLine(const std::string& text) { return text.substr(0, text.find('\r')); }

std::string checkJson(const HeaderData& header, const SaveFindings& findings, const TrackerFindings* tracker)
{
    nlohmann::ordered_json json;
    json["FilePath"] = Latin1ToUtf8(header.FilePath);
    json["refusals"] = findings.refusals;
    json["missing_username"] = findings.missingUserName;
    json["fixups"] = {{"certify_invertnext", findings.fixups.certifyInvertNext},
                      {"rotation", findings.fixups.rotation},
                      {"write", findings.fixups.write},
                      {"color", findings.fixups.color}};
    if (tracker != nullptr) {
        json["tracker"] = nlohmann::ordered_json::array();
        for (const auto& finding : *tracker)
            json["tracker"].push_back(
                {{"id", finding.id}, {"level", LevelText(finding.level)}, {"text", finding.text}});
    }
    return json.dump() + '\n';
}

std::string findingLines(const std::string& path, const SaveFindings& findings, const TrackerFindings* tracker)
{
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
            lines += path + ": tracker " + LevelText(finding.level) + " " + finding.id + ": " + finding.text + '\n';
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
// unreadable file is reported as such.
FileReport reportOn(const std::string& path, ConsoleDialogs::Answerer answerer, FolderSweeps* restoreWith,
                    const std::function<void(HeaderData&, ConsoleDialogs&, FileReport&)>& handle)
{
    FileReport report;
    std::ostringstream err;
    ConsoleDialogs dialogs(err, std::move(answerer));
    auto header = OpenForCli(path, dialogs, err, restoreWith);
    if (!header) {
        report.unreadable = true;
        report.status = ExitStatus::Unreadable;
    } else {
        try {
            handle(*header, dialogs, report);
        } catch (const std::exception& failure) {
            ReportUnreadable(path, failure, err);
            report = FileReport{};
            report.unreadable = true;
            report.status = ExitStatus::Unreadable;
        }
    }
    report.err = err.str();
    return report;
}

std::string outputClosedText(int error)
{
    const char* name = ::strerrorname_np(error);
    return std::string("standard output closed (") + (name != nullptr ? name : "error") + ")";
}

int runBatch(const std::vector<std::string>& arguments, const BatchOptions& batch, std::ostream& out, std::ostream& err,
             const std::function<FileReport(const std::string&)>& work)
{
    const auto files = ExpandPartFiles(arguments);
    Summary summary;
    int status = ExitStatus::Ok;
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

std::string savedLine(const std::string& path, const SaveOptions& options, const SaveResult& result,
                      ConsoleDialogs& dialogs, FileReport& report)
{
    switch (result.outcome) {
    case SaveOutcome::Saved:
        report.saving = FileReport::Saving::Saved;
        return "saved " + path + (options.backup ? " (backup: " + result.backupPath + ")" : " (no backup)") + '\n';
    case SaveOutcome::Declined:
        report.saving = FileReport::Saving::Skipped;
        report.status = ExitStatus::Refused;
        return "skipped " + path + ": no user name set\n";
    case SaveOutcome::Failed:
        report.saving = FileReport::Saving::Failed;
        report.status = ExitStatus::SaveFailed;
        return "failed " + path + ": " +
               (dialogs.lastTitle() == ChangedOnDiskTitle ? "changed while saving" : dialogs.lastMessage()) + '\n';
    case SaveOutcome::Refused:
    case SaveOutcome::DescriptionTooLong: break;
    }
    report.saving = FileReport::Saving::Skipped;
    report.status = ExitStatus::Refused;
    report.refusals.push_back(firstLine(dialogs.lastMessage()));
    return "skipped " + path + ": " + firstLine(dialogs.lastMessage()) + '\n';
}

} // namespace

int RunCheck(const std::vector<std::string>& arguments, const CheckOptions& options, const BatchOptions& batch,
             std::ostream& out, std::ostream& err)
{
    StringList categories;
    if (options.tracker && !readCategories(categories, err))
        return ExitStatus::Unreadable;
    // A check never writes, not even to undo what a killed save left: the next save does that.
    return runBatch(arguments, batch, out, err, [&](const std::string& path) {
        return reportOn(path, {}, nullptr, [&](HeaderData& header, ConsoleDialogs&, FileReport& report) {
            const auto findings = EvaluateSaveChecks(header, batch.limitDescription);
            TrackerFindings tracker; // empty unless asked for
            if (options.tracker)
                tracker = CheckRecordForTracker(header, ComposeHeader(header), categories);
            const auto* trackerFindings = options.tracker ? &tracker : nullptr;
            report.out = options.json ? checkJson(header, findings, trackerFindings)
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
        return reportOn(path, answer, &sweeps, [&](HeaderData& header, ConsoleDialogs& dialogs, FileReport& report) {
            const SaveContext context{dialogs,        clock,
                                      options.backup, [&header] { return ComposeHeader(header); },
                                      [] {},          batch.limitDescription,
                                      &sweeps};
            report.out = savedLine(header.FilePath, options, CheckHeaderAndSave(header, context), dialogs, report);
        });
    });
}
