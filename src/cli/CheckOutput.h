// SPDX-License-Identifier: MIT
#pragma once

#include <nlohmann/json.hpp>
#include <string>
#include <vector>

#include "FileFindings.h"
#include "FindingLines.h"
#include "RuleChoice.h"

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

// Every finding of file with its place in the file on disk, in the order of the places.
std::vector<FileFinding> PlacedFindings(const CheckedFile& file, const HeaderData& header,
                                        const std::string& composedHeader);

// The forms check writes, and the folder their paths are relative to (the working folder, for
// GitHub $GITHUB_WORKSPACE when set).
struct OutputForm {
    OutputFormat format = OutputFormat::Text;
    std::string base;
};

// One file's output of check in the chosen form.
std::string CheckOutput(const OutputForm& form, const HeaderData& header, const CheckedFile& file,
                        const std::vector<FileFinding>& findings);

// The JSON object of a file's save checks, without its Tracker findings.
nlohmann::ordered_json CheckJson(const HeaderData& header, const SaveFindings& save);
