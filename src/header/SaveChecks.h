// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "Dialogs.h"
#include "HeaderData.h"
#include "SafeReplace.h"

class Clock;
class Dialogs;

inline constexpr std::size_t DescriptionLimit = 64;

// The title of the question asked when the author line has no user name.
inline constexpr const char* MissingUserNameTitle = Translatable("Messages", "Missing Username");

// A stop text as the box shows it: the sentence, CR LF, "Saving the file is not possible".
std::string RefusalText(const std::string& sentence);

struct FixUpOffers {
    bool certifyInvertNext = false, rotation = false, write = false, color = false;
};

// The names under which reports list the save checks, stable from one version to the next.
namespace SaveCheckIds {
inline constexpr const char* DescriptionLength = "save.description-length";
inline constexpr const char* Author = "save.author";
inline constexpr const char* UserName = "save.username";
inline constexpr const char* Bfc = "save.bfc";
inline constexpr const char* License = "save.license";
inline constexpr const char* PartType = "save.type";
inline constexpr const char* NeedsWork = "save.needs-work-comment";
} // namespace SaveCheckIds

// Every check at once, for tools that list what a save would say.
struct SaveFindings {
    std::vector<std::string> refusals;   // the stop texts, in the order the save checks them
    std::vector<std::string> refusalIds; // the check of each stop text
    bool missingUserName = false;
    FixUpOffers fixups;
};
// With limitDescription off, the description may be of any length.
SaveFindings EvaluateSaveChecks(const HeaderData& header, bool limitDescription = true);

enum class SaveOutcome {
    Saved,
    DescriptionTooLong, // refused; the caller shows the description with its characters after the 64th selected
    Refused,            // another check stopped the save
    Declined,           // the user did not want to save without a user name
    Failed,             // writing failed, and was reported
    Unchanged,          // the file holds the text already, so nothing was written
    NotWritten,         // checked and fixed up, and not written: a dry run
};

// What the save needs from whoever holds the header: the composed text to write, and a way to
// compose it again after a fix-up changed the header.
struct SaveContext {
    Dialogs& dialogs;
    const Clock& clock;
    bool makeBackup;
    std::function<std::string()> newHeader;
    std::function<void()> recompose;
    bool limitDescription = true; // off: the description may be of any length
    // Where the user turns the description's limit off, told below its refusal; empty: not told.
    std::string limitSwitch = {};
    // On: a save that would write what the file holds already writes nothing.
    bool skipUnchanged = false;
    bool dryRun = false;     // everything but the writing
    ReplaceOptions run = {}; // the sweeps, the lock wait and the home of the run (see ReplaceOptions)
};

struct SaveResult {
    SaveOutcome outcome;
    std::string backupPath; // when saved with a backup
};

// The checks in their fixed order, the fix-up questions, then FileSave.
SaveResult CheckHeaderAndSave(HeaderData& header, const SaveContext& context);
