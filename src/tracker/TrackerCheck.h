// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "ColourCodes.h"
#include "HeaderData.h"

// The Parts Tracker's admission rules for a part file's header and lines, checked offline. They
// are the library's, stricter than the save checks, and change nothing. The rules that need the
// Tracker's database (registered authors, duplicates, held subfiles) are out of reach here.

enum class FindingLevel { Error, Warning }; // an error: the Tracker refuses the upload

struct TrackerFinding {
    std::string id; // the Tracker's own id of the rule, such as "license.approved"
    FindingLevel level;
    std::string text; // what is wrong, naming the offending value
    int line = 0;     // the line of the checked text it is about; 0 for the file as a whole
};

const char* LevelText(FindingLevel level); // "error" or "warning"

// text is what saving writes (the composed header and the body), fileName the file's own name,
// categories the official categories, colours the codes of LDConfig.ldr.
std::vector<TrackerFinding> CheckForTracker(std::string_view text, const std::string& fileName,
                                            const StringList& categories, const ColourCodes& colours);

// The same for the record as it would be saved.
std::vector<TrackerFinding> CheckRecordForTracker(const HeaderData& header, const std::string& composedHeader,
                                                  const StringList& categories, const ColourCodes& colours);
