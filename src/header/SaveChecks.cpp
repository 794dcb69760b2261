// SPDX-License-Identifier: MIT
#include "SaveChecks.h"

#include "Dialogs.h"
#include "FileSave.h"
#include "FixUps.h"
#include "Text.h"

namespace {

bool descriptionTooLong(const HeaderData& h)
{
    return CharacterCount(h.PartDescription, h.Encoding) > DescriptionLimit;
}
bool missingUserName(const HeaderData& h) { return h.AuthorUserName.empty(); }

// One step of the save's checks: a rule that stops the save with its sentence, or the question
// whether to save without a user name.
struct Check {
    const char* id;       // the check's name in reports, "save." and a few words
    const char* sentence; // nullptr for the user-name question
    bool (*fails)(const HeaderData&);
    SaveOutcome outcome = SaveOutcome::Refused;
};

// The checks in the one order in which a save makes them and a check lists them.
const Check Checks[] = {
    {SaveCheckIds::DescriptionLength,
     Translatable("Messages", "Length of the part description is limited to 64 characters!"), descriptionTooLong,
     SaveOutcome::DescriptionTooLong},
    {SaveCheckIds::Author, Translatable("Messages", "You need to mention the Author!"),
     [](const HeaderData& h) { return h.AuthorRealName.empty(); }},
    {SaveCheckIds::UserName, nullptr, missingUserName},
    {SaveCheckIds::Bfc, Translatable("Messages", "You need to set the BFC type!"),
     [](const HeaderData& h) { return h.Bfc.empty(); }},
    {SaveCheckIds::License, Translatable("Messages", "You need to set the License type!"),
     [](const HeaderData& h) { return h.License.empty(); }},
    {SaveCheckIds::PartType, Translatable("Messages", "You need to set the Part type!"),
     [](const HeaderData& h) { return h.PartType.empty(); }},
    {SaveCheckIds::NeedsWork, Translatable("Messages", "Parts with 'needs work' in title needs a proper comment!"),
     [](const HeaderData& h) { return h.NeedsWork && h.Comments.empty(); }},
};

// The one check that the author may turn off: today's header standard no longer limits it.
bool applies(const Check& check, bool limitDescription)
{
    return limitDescription || check.outcome != SaveOutcome::DescriptionTooLong;
}

bool askedYes(Dialogs& dialogs, const char* text, const char* title)
{
    return dialogs.message(QuestionBox(text, title)) == Answer::Yes;
}

void offerFixUps(HeaderData& h, const SaveContext& context)
{
    auto& dialogs = context.dialogs;
    if (HasCertifyInvertNext(h.Body) &&
        askedYes(dialogs, Translatable("Messages", "Should this be corrected?"), "BFC CERTIFY INVERTNEXT"))
        FixCertifyInvertNext(h.Body);
    if (HasRotationLines(h.Body) &&
        askedYes(dialogs, Translatable("Messages", "Should the \"0 ROTATION\" entries being deleted?"),
                 Translatable("Messages", "ROTATION in file")))
        DeleteRotationLines(h.Body);
    if (HasWriteLines(h.Body) &&
        askedYes(dialogs, Translatable("Messages", "Should the \"0 WRITE\" entries being deleted?"),
                 Translatable("Messages", "ROTATION in file")))
        RemoveWriteKeywords(h.Body);
    if (HasColorLines(h) && askedYes(dialogs, Translatable("Messages", "Should the COLOR Entry be deleted?"),
                                     Translatable("Messages", "COLOR Entry"))) {
        ClearColorLines(h);
        context.recompose();
    }
}

} // namespace

std::string RefusalText(const std::string& sentence)
{
    return sentence + "\r\n" + Translatable("Messages", "Saving the file is not possible");
}

SaveFindings EvaluateSaveChecks(const HeaderData& h, bool limitDescription)
{
    SaveFindings findings;
    for (const auto& check : Checks) {
        if (!applies(check, limitDescription) || !check.fails(h))
            continue;
        if (check.sentence == nullptr)
            findings.missingUserName = true;
        else {
            findings.refusals.push_back(RefusalText(check.sentence));
            findings.refusalIds.emplace_back(check.id);
        }
    }
    findings.fixups = {HasCertifyInvertNext(h.Body), HasRotationLines(h.Body), HasWriteLines(h.Body), HasColorLines(h)};
    return findings;
}

SaveResult CheckHeaderAndSave(HeaderData& h, const SaveContext& context)
{
    auto& dialogs = context.dialogs;
    for (const auto& check : Checks) {
        if (!applies(check, context.limitDescription) || !check.fails(h))
            continue;
        if (check.sentence != nullptr) {
            auto refusal = RefusalText(check.sentence);
            if (check.outcome == SaveOutcome::DescriptionTooLong && !context.limitSwitch.empty())
                refusal += "\r\n" + context.limitSwitch + " lifts this limit when it is cleared.";
            dialogs.message(StopBox(refusal));
            return {check.outcome, {}};
        }
        if (!askedYes(dialogs, Translatable("Messages", "You have not set your username. Do you want to save anyway?"),
                      MissingUserNameTitle))
            return {SaveOutcome::Declined, {}};
    }
    offerFixUps(h, context);
    auto newHeader = context.newHeader();
    if (context.skipUnchanged && FileHoldsSavedText(h, newHeader))
        return {SaveOutcome::Unchanged, {}};
    if (context.dryRun)
        return {SaveOutcome::NotWritten, {}};
    const auto saved = FileSave(h, std::move(newHeader), context.makeBackup, context.clock, dialogs, context.run);
    return {saved.saved ? SaveOutcome::Saved : SaveOutcome::Failed, saved.backupPath};
}
