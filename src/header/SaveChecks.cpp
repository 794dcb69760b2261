#include "SaveChecks.h"

#include "Dialogs.h"
#include "FileSave.h"
#include "FixUps.h"
#include "Text.h"

namespace {

struct Rule {
    const char* sentence;
    bool (*fails)(const HeaderData&);
};

bool descriptionTooLong(const HeaderData& h) { return CharacterCount(h.PartDescription, h.Encoding) > DescriptionLimit; }

const Rule DescriptionRule{"Length of the part description is limited to 64 character!", descriptionTooLong};
const Rule AuthorRule{"You need to mention the Author!", [](const HeaderData& h) { return h.AuthorRealName.empty(); }};

// The checks that come after the user-name question, in their order.
const Rule LaterRules[] = {
    {"You need to set the BFC type!", [](const HeaderData& h) { return h.Bfc.empty(); }},
    {"You need to set the Liscense type!", [](const HeaderData& h) { return h.License.empty(); }},
    {"You need to set the Part type!", [](const HeaderData& h) { return h.PartType.empty(); }},
    {"Parts with 'needs work' in title needs a proper comment!",
     [](const HeaderData& h) { return h.NeedsWork && h.Comments.empty(); }},
};

bool missingUserName(const HeaderData& h) { return h.AuthorUserName.empty(); }

bool stops(const Rule& rule, const HeaderData& header, Dialogs& dialogs)
{
    if (!rule.fails(header))
        return false;
    dialogs.message(StopBox(RefusalText(rule.sentence)));
    return true;
}

bool askedYes(Dialogs& dialogs, const char* text, const char* title)
{
    return dialogs.message(QuestionBox(text, title)) == Answer::Yes;
}

void offerFixUps(HeaderData& h, const SaveContext& context)
{
    auto& dialogs = context.dialogs;
    if (HasCertifyInvertNext(h.Body) && askedYes(dialogs, "Should this be corrected?", "BFC CERTIFY INVERTNEXT"))
        FixCertifyInvertNext(h.Body);
    if (HasRotationLines(h.Body) &&
        askedYes(dialogs, "Should the \"0 ROTATION\" entries being deleted?", "ROTATION in file"))
        DeleteRotationLines(h.Body);
    if (HasWriteLines(h.Body) && askedYes(dialogs, "Should the \"0 WRITE\" entries being deleted?", "ROTATION in file"))
        RemoveWriteKeywords(h.Body);
    if (HasColorLines(h) && askedYes(dialogs, "Should the COLOR Entry be deleted?", "COLOR Entry")) {
        ClearColorLines(h);
        context.recompose();
    }
}

} // namespace

std::string RefusalText(const std::string& sentence) { return sentence + "\r\nSaving the file is not possible"; }

SaveFindings EvaluateSaveChecks(const HeaderData& h)
{
    SaveFindings findings;
    for (const auto* rule : {&DescriptionRule, &AuthorRule})
        if (rule->fails(h))
            findings.refusals.push_back(RefusalText(rule->sentence));
    for (const auto& rule : LaterRules)
        if (rule.fails(h))
            findings.refusals.push_back(RefusalText(rule.sentence));
    findings.missingUserName = missingUserName(h);
    findings.fixups = {HasCertifyInvertNext(h.Body), HasRotationLines(h.Body), HasWriteLines(h.Body), HasColorLines(h)};
    return findings;
}

SaveResult CheckHeaderAndSave(HeaderData& h, const SaveContext& context)
{
    auto& dialogs = context.dialogs;
    if (stops(DescriptionRule, h, dialogs))
        return {SaveOutcome::DescriptionTooLong, {}};
    if (stops(AuthorRule, h, dialogs))
        return {SaveOutcome::Refused, {}};
    if (missingUserName(h) &&
        !askedYes(dialogs, "You have not set your username. Do you want to save anyway?", MissingUserNameTitle))
        return {SaveOutcome::Declined, {}};
    for (const auto& rule : LaterRules)
        if (stops(rule, h, dialogs))
            return {SaveOutcome::Refused, {}};
    offerFixUps(h, context);
    const auto saved = FileSave(h, context.newHeader(), context.makeBackup, context.clock, dialogs);
    return {saved.saved ? SaveOutcome::Saved : SaveOutcome::Failed, saved.backupPath};
}
