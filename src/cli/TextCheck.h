// SPDX-License-Identifier: MIT
#pragma once

#include <set>
#include <string>
#include <string_view>
#include <vector>

#include "FileFindings.h"
#include "FileRepairs.h"
#include "HeaderData.h"
#include "SaveChecks.h"
#include "TrackerCheck.h"

class ColourSource;
class Dialogs;

// What check weighs a part by: the save checks, and the Parts Tracker's rules when their lists are given.
struct CheckSetup {
    bool limitDescription = true;           // the description's 64 characters
    const StringList* categories = nullptr; // the official categories; null: no Tracker rules
    ColourSource* colours = nullptr;        // where each part's colour codes come from
};

// What the checks say about one record.
struct RecordCheck {
    SaveFindings save;
    std::string composed;                // the header a save would write
    std::vector<TrackerFinding> tracker; // empty unless the Tracker's rules were checked
};

// The checks of check on an open record; dialogs hears of an unusable LDConfig.ldr.
RecordCheck CheckRecord(const HeaderData& header, const CheckSetup& setup, Dialogs& dialogs);

// Whether the checks found anything to say (a finding of the Tracker's rules, a refusal, a missing
// user name, a fix-up of the header's colour lines): only then are the file's bytes needed.
bool HasFindings(const RecordCheck& check);

// Every finding of check, save checks first, each at its place in fileBytes, the file as read.
std::vector<FileFinding> FindingsOfRecord(const HeaderData& header, const RecordCheck& check,
                                          std::string_view fileBytes, bool tracker);

// check on a part's text held in memory, as if path held these bytes: the same reading as a file's
// (an LF-only text is read as CR LF), the same checks, the same findings. Files near path (the
// colour list) are read, nothing is written. Throws what reading the text throws (a binary text).
std::vector<FileFinding> CheckPartText(const std::string& bytes, const std::string& path, const CheckSetup& setup);

// fix's repairs (those named in chosen) of a part's text held in memory: the edits fix would make
// of a file with these bytes, without header edits.
FileRepairs RepairPartText(const std::string& bytes, const std::string& path, const std::set<std::string>& chosen,
                           const FixContext& context);
