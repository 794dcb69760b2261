// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <vector>

#include "Clock.h"
#include "ColourCodes.h"
#include "HeaderData.h"
#include "TrackerCheck.h"

// One list of what stands between the open document and a save the Parts Tracker accepts: the save
// checks' refusals and warnings (ids "save.…") beside the Tracker's findings.

struct StopRow {
    TrackerFinding finding;  // its line is the file's line on disk; 0 where it is about no one line
    bool repairable = false; // a repair exists and changes the document as it stands
    // A save check: what lifts it (the field to fill, or the preference to clear). A finding that
    // has a repair which cannot be made here: why.
    std::string note;
};

struct StopContext {
    const StringList& categories;
    const ColourCodes& colours;
    bool limitDescription = true;
    std::string limitSwitch; // where the author clears the description's limit
    LocalDateTime today;
};

// The save checks' rows in the order a save makes them, then the Tracker's findings.
std::vector<StopRow> WhatStopsTheSave(const HeaderData& header, const std::string& composedHeader,
                                      const StopContext& context);

// True for a row of the save checks rather than of the Tracker's rules.
bool IsSaveCheckRow(const StopRow& row);
