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

// What the save checks say about a file, in their order: a refusal is an error, a missing user
// name a warning, a fix-up a save would offer a note.
std::vector<FileFinding> SaveCheckFindings(const SaveFindings& save, const FindingPlaces& places);

// The findings of the Parts Tracker's rules, placed on the file's lines.
std::vector<FileFinding> TrackerFileFindings(const std::vector<TrackerFinding>& tracker, const FindingPlaces& places);
