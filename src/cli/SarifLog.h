// SPDX-License-Identifier: MIT
#pragma once

#include <ostream>
#include <string>
#include <string_view>
#include <vector>

#include "FileFindings.h"

// SARIF 2.1.0, the form code-scanning services and editors read findings in. A run's results are
// gathered file by file, one JSON object a line, and written as one log at the end.

// The findings of the file at path as SARIF results, one JSON object per line. The file's URI is
// relative to the current folder where it lies below it, else an absolute file URI.
std::string SarifResultLines(const std::string& path, const std::vector<FileFinding>& findings);

// The log of one run of this program whose results are resultLines, with a rule for each id used.
void WriteSarifLog(std::string_view resultLines, std::ostream& out);
