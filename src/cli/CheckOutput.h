// SPDX-License-Identifier: MIT
#pragma once

#include <nlohmann/json.hpp>
#include <string>
#include <vector>

#include "FileFindings.h"
#include "FindingLines.h"

// One file's output of check in the chosen form; tracker is null unless the Parts Tracker's
// rules were checked. composedHeader is the header a save would write, fileBytes the file as read.
std::string CheckOutput(OutputFormat format, const HeaderData& header, const std::string& composedHeader,
                        std::string_view fileBytes, const SaveFindings& save,
                        const std::vector<TrackerFinding>* tracker);

// The JSON object of a file's save checks, and of its Tracker findings when given.
nlohmann::ordered_json CheckJson(const HeaderData& header, const SaveFindings& save,
                                 const std::vector<FileFinding>* tracker);
