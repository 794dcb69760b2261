// SPDX-License-Identifier: MIT
#pragma once

#include <ostream>
#include <string>
#include <string_view>
#include <vector>

#include "FileFindings.h"

struct RuleText;

// SARIF 2.1.0, the form code-scanning services and editors read findings in. The log is written
// as the run goes: its head with every rule, then each file's results as they come, then its
// end, so that no more than one file's results are ever held.

// Where the rule's explanation is read on the web (its section of docs/rules.md): SARIF's helpUri,
// the language server's codeDescription.
std::string RuleHelpUri(const RuleText& rule);

// The findings of the file at path as SARIF results, one JSON object per line. The file's URI is
// relative to %SRCROOT% (base, the working folder) where it lies below it, else an absolute file
// URI. Two equal findings in one file get different prints.
std::string SarifResultLines(const std::string& path, const std::vector<FileFinding>& findings,
                             const std::string& base);

class SarifLogWriter {
public:
    // Writes the head of the log of one run of this program, whose %SRCROOT% is base.
    SarifLogWriter(std::ostream& out, const std::string& base);
    // Writes results, as SarifResultLines gives them.
    void write(std::string_view resultLines);
    // Writes the end of the log.
    void finish();

private:
    std::ostream& out_;
    bool first_ = true;
};
