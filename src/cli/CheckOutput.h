// SPDX-License-Identifier: MIT
#pragma once

#include <nlohmann/json.hpp>
#include <string>
#include <vector>

#include "FileFindings.h"
#include "FindingLines.h"
#include "TextCheck.h"

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
