// SPDX-License-Identifier: MIT
#pragma once

#include <array>
#include <string>
#include <vector>

#include "SaveChecks.h"

// What a batch command found for one file: its output, and the facts the summary counts.
struct FileReport {
    std::string out; // for standard output
    std::string err; // for standard error
    int status = 0;  // the file's exit status
    bool unreadable = false;
    bool refused = false;              // by a save check, or by an error of the Parts Tracker's rules
    std::vector<std::string> refusals; // the first line of each stop text
    bool missingUserName = false;
    FixUpOffers fixups;
    std::vector<std::string> trackerIds; // one per finding of the Parts Tracker's rules
    enum class Saving { NotAsked, Saved, Previewed, Unchanged, Skipped, Failed } saving = Saving::NotAsked;
};

struct FixUpName {
    bool offered;
    const char* what; // the words the output uses for it
    const char* id;   // its name in reports
};

// Each fix-up, whether it is offered.
inline std::array<FixUpName, 4> FixUpNames(const FixUpOffers& f)
{
    return {{{f.certifyInvertNext, "0 BFC CERTIFY INVERTNEXT in the body", "save.fixup.certify-invertnext"},
             {f.rotation, "0 ROTATION lines in the body", "save.fixup.rotation"},
             {f.write, "0 WRITE lines in the body", "save.fixup.write"},
             {f.color, "COLOR lines in the header", "save.fixup.color"}}};
}
