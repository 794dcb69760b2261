// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <functional>
#include <optional>
#include <set>
#include <string>
#include <string_view>
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
    // The same for one line of the body, number being its line on disk, for the repairs that change
    // body lines only (the others: null): the line rewritten, or nothing when it stays.
    std::optional<std::string> (*repairLine)(std::string_view line, std::size_t number, FixNote& note) = nullptr;
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

// The same, found being the ids of the findings the record has; step sees the record after each
// repair that ran.
std::vector<FixDone> FixForTracker(HeaderData& header, const std::set<std::string>& chosen, const FixContext& context,
                                   const std::set<std::string>& found,
                                   const std::function<void(const FixDone&, const HeaderData&)>& step);
