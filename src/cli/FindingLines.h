// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <vector>

#include "FileFindings.h"

// The forms check prints its findings in.
enum class OutputFormat { Text, Json, Sarif, Github };

// One line per finding as gcc and clang write them, which Vim's errorformat, Emacs's compile mode
// and problem matchers read: "path:line:column: severity: message [id]", a finding about the file
// as a whole on line 1, column 1; control characters shown escaped; "path: ok" when there is none.
std::string TextFindingLines(const std::string& path, const std::vector<FileFinding>& findings);

// The folder the GitHub format's paths are relative to: $GITHUB_WORKSPACE when it is set, else
// the current folder.
std::string GithubBaseFolder();

// One GitHub Actions workflow command per finding,
// "::error file=…,line=…,col=…,title=<id>::message", escaped as the runner wants; the path
// relative to base where the file lies below it, else absolute.
std::string GithubFindingLines(const std::string& path, const std::vector<FileFinding>& findings,
                               const std::string& base);
