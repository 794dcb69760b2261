// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <vector>

#include "FileFindings.h"

// The forms check prints its findings in.
enum class OutputFormat { Text, Json, Sarif, Github };

// One line per finding as editors and compilers write them, "path:line: level id: message"
// ("path: level id: message" without a line), control characters shown escaped; "path: ok"
// when there is none.
std::string TextFindingLines(const std::string& path, const std::vector<FileFinding>& findings);

// One GitHub Actions workflow command per finding, "::error file=…,line=…,title=<id>::message",
// escaped as the runner wants; path as given, relative to the current folder where it lies below.
std::string GithubFindingLines(const std::string& path, const std::vector<FileFinding>& findings);
