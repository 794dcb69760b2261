#include "CheckCommands.h"

#include <nlohmann/json.hpp>

#include "CliFiles.h"
#include "Clock.h"
#include "Composer.h"
#include "FileSave.h"
#include "ConsoleDialogs.h"
#include "SaveChecks.h"
#include "Text.h"

namespace {

std::string checkJson(const HeaderData& header, const SaveFindings& findings)
{
    nlohmann::ordered_json json;
    json["FilePath"] = Latin1ToUtf8(header.FilePath);
    json["refusals"] = findings.refusals;
    json["missing_username"] = findings.missingUserName;
    json["fixups"] = {{"certify_invertnext", findings.fixups.certifyInvertNext},
                      {"rotation", findings.fixups.rotation},
                      {"write", findings.fixups.write},
                      {"color", findings.fixups.color}};
    return json.dump();
}

void printFindings(std::ostream& out, const std::string& path, const SaveFindings& findings)
{
    for (const auto& refusal : findings.refusals)
        out << path << ": refused: " << refusal.substr(0, refusal.find('\r')) << '\n';
    if (findings.missingUserName)
        out << path << ": missing user name\n";
    const auto& f = findings.fixups;
    const std::pair<bool, const char*> offers[] = {{f.certifyInvertNext, "0 BFC CERTIFY INVERTNEXT in the body"},
                                                   {f.rotation, "0 ROTATION lines in the body"},
                                                   {f.write, "0 WRITE lines in the body"},
                                                   {f.color, "COLOR lines in the header"}};
    bool anything = !findings.refusals.empty() || findings.missingUserName;
    for (const auto& [offered, what] : offers) {
        if (offered)
            out << path << ": fix-up offered: " << what << '\n';
        anything = anything || offered;
    }
    if (!anything)
        out << path << ": ok\n";
}

} // namespace

int RunCheck(const std::vector<std::string>& paths, bool json, ConsoleDialogs& dialogs, std::ostream& out,
             std::ostream& err)
{
    return ForEachOpenedFile(paths, dialogs, err, [&](HeaderData& header) {
        const auto findings = EvaluateSaveChecks(header);
        if (json)
            out << checkJson(header, findings) << '\n';
        else
            printFindings(out, header.FilePath, findings);
        return findings.refusals.empty() ? ExitStatus::Ok : ExitStatus::Refused;
    });
}

int RunSave(const std::vector<std::string>& paths, const SaveOptions& options, std::ostream& out, std::ostream& err)
{
    ConsoleDialogs dialogs(err, [&options](const MessageBox& box) {
        // Another program's changes since the file was read are never overwritten from here.
        if (box.title == ChangedOnDiskTitle)
            return Answer::No;
        const bool userNameQuestion = box.title == MissingUserNameTitle;
        const bool yes = userNameQuestion ? options.allowMissingUserName : options.fix;
        return yes ? Answer::Yes : Answer::No;
    });
    const SystemClock clock;
    return ForEachOpenedFile(paths, dialogs, err, [&](HeaderData& header) {
        const SaveContext context{dialogs, clock, options.backup, [&header] { return ComposeHeader(header); }, [] {}};
        const auto& path = header.FilePath;
        const auto result = CheckHeaderAndSave(header, context);
        switch (result.outcome) {
        case SaveOutcome::Saved:
            out << "saved " << path << (options.backup ? " (backup: " + result.backupPath + ")" : " (no backup)") << '\n';
            return ExitStatus::Ok;
        case SaveOutcome::Declined:
            out << "skipped " << path << ": no user name set\n";
            return ExitStatus::Refused;
        case SaveOutcome::Failed:
            out << "failed " << path << ": " << (dialogs.lastTitle() == ChangedOnDiskTitle ? "changed while saving" : dialogs.lastMessage()) << '\n';
            return ExitStatus::SaveFailed;
        case SaveOutcome::Refused:
        case SaveOutcome::DescriptionTooLong:
            break;
        }
        const auto& refusal = dialogs.lastMessage();
        out << "skipped " << path << ": " << refusal.substr(0, refusal.find('\r')) << '\n';
        return ExitStatus::Refused;
    });
}
