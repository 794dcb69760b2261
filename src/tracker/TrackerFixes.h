// SPDX-License-Identifier: MIT
#pragma once

#include <set>
#include <string>
#include <vector>

#include "ColourCodes.h"
#include "HeaderFixes.h"

// The repairs of the Parts Tracker's findings that have one correct mechanical repair, in the order
// they run. A repair runs only on a finding the file has, and leaves the file with no finding it
// did not have before.

struct TrackerFix {
    const char* id; // the Tracker's id of the finding it clears
    bool onByDefault;
    // Its change reaches other rules than its own, so the file is checked again after it and the
    // change is undone when it brings a finding the file did not have.
    bool checkedAfter;
    void (*apply)(HeaderData& header, const HeaderFixContext& context, FixNote& note);
};

const std::vector<TrackerFix>& TrackerFixes();

// The ids of the repairs that run unless others are chosen.
std::set<std::string> DefaultFixIds();

struct FixContext {
    HeaderFixContext header;
    const ColourCodes& colours; // for the checks before and after
};

struct FixDone {
    std::string id;
    FixNote note;
};

// Runs the repairs named in chosen on the record, in the table's order; each repair that found its
// finding tells what it did.
std::vector<FixDone> FixForTracker(HeaderData& header, const std::set<std::string>& chosen, const FixContext& context);
