// SPDX-License-Identifier: MIT
#pragma once

#include <nlohmann/json.hpp>
#include <string>
#include <vector>

#include "FileFindings.h"
#include "FindingLines.h"
#include "TextCheck.h"

// One file's output of check in the chosen form; tracker tells whether the Parts Tracker's rules
// were checked. fileBytes is the file as read.
std::string CheckOutput(OutputFormat format, const HeaderData& header, const RecordCheck& check,
                        std::string_view fileBytes, bool tracker);

// The JSON object of a file's save checks, and of its Tracker findings when given.
nlohmann::ordered_json CheckJson(const HeaderData& header, const SaveFindings& save,
                                 const std::vector<FileFinding>* tracker);
