// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <vector>

#include "FindingPlaces.h"
#include "HeaderData.h"
#include "SaveChecks.h"
#include "TrackerCheck.h"

enum class Severity { Error, Warning, Note };

const char* SeverityText(Severity severity); // "error", "warning" or "note"

// One thing a check says about a file, with the place an editor opens.
struct FileFinding {
    std::string id; // a save check's ("save.author") or the Parts Tracker's ("license.approved")
    Severity severity;
    std::string message;
    FindingPlace place;
};

// Findings in the order of their places in the file, line by line and column by column; a
// finding about the file as a whole stands on line 1, column 1.
void SortByPlace(std::vector<FileFinding>& findings);

// What the save checks say about a file, in their order: a refusal is an error, a missing user
// name a warning, a fix-up a save would offer a note.
std::vector<FileFinding> SaveCheckFindings(const SaveFindings& save, const FindingPlaces& places);

// Under the Parts Tracker's rules, a description over the limit only warns: the Tracker takes it.
FileFinding DescriptionLengthWarning(const HeaderData& header, const FindingPlaces& places);

// The findings of the Parts Tracker's rules, placed on the file's lines.
std::vector<FileFinding> TrackerFileFindings(const std::vector<TrackerFinding>& tracker, const FindingPlaces& places);
