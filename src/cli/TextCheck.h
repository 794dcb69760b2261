// SPDX-License-Identifier: MIT
#pragma once

#include <set>
#include <string>
#include <string_view>
#include <vector>

#include "FileFindings.h"
#include "FileRepairs.h"
#include "HeaderData.h"
#include "PartSettings.h"
#include "RuleChoice.h"
#include "SaveChecks.h"
#include "TrackerCheck.h"

class ColourSource;
class Dialogs;

// What check reports of one file: the save checks and, when asked for, the Parts Tracker's rules,
// the findings a rule choice leaves out already taken out.
struct CheckedFile {
    SaveFindings save;
    bool lengthWarning = false; // under the Tracker's rules a long description is a warning, not a refusal
    bool trackerChecked = false;
    std::vector<TrackerFinding> tracker;
};

// Takes out of file what choice does not report.
void KeepReported(CheckedFile& file, const RuleChoice& choice);

// What the Parts Tracker's rules read besides the part: without categories they are not checked.
struct TrackerLists {
    const StringList* categories = nullptr; // the official categories; null: no Tracker rules
    ColourSource* colours = nullptr;        // where each part's colour codes come from
};

// What check says of one open record.
struct RecordCheck {
    CheckedFile file;
    std::string composed; // the header a save would write
};

// The checks of check on an open record with its part's settings (rule choice, description limit,
// LDConfig.ldr); dialogs hears of an unusable LDConfig.ldr. check and the language server both
// check a part through this one function.
RecordCheck CheckRecord(const HeaderData& header, const PartSettings& settings, const TrackerLists& lists,
                        Dialogs& dialogs);

// Whether a finding of file has a place in the file: only then are the file's bytes needed.
bool HasPlacedFindings(const CheckedFile& file);

// Every finding of check with its place in fileBytes (the file as read), in the order of the places.
std::vector<FileFinding> PlacedFindings(const RecordCheck& check, const HeaderData& header, std::string_view fileBytes);

// check on a part's text held in memory, as if path held these bytes, with the settings of that part:
// the same reading as a file's (an LF-only text is read as CR LF), the same checks, the same findings.
// Files near path (the colour list) are read, nothing is written. Throws what reading the text throws
// (a binary text).
std::vector<FileFinding> CheckPartText(const std::string& bytes, const std::string& path, const PartSettings& settings,
                                       const TrackerLists& lists);

// fix's repairs (those named in chosen) of a part's text held in memory: the edits fix would make
// of a file with these bytes, without header edits.
FileRepairs RepairPartText(const std::string& bytes, const std::string& path, const std::set<std::string>& chosen,
                           const FixContext& context);
