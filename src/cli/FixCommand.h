// SPDX-License-Identifier: MIT
#pragma once

#include <ostream>
#include <string>
#include <vector>

#include "CheckCommands.h"

struct FixOptions {
    std::vector<std::string> only; // the repairs to run; none: those on by default
    bool recompose = false;        // save the recomposed header as edit does, after the save checks
};

// fix: the Parts Tracker's findings that have one correct repair, repaired after edit's changes.
// Each repair is an edit of the file's bytes as they stand, written through the safe save (no
// backup unless options.backup); with recompose, the record is repaired and saved as edit saves.
// A name in only that is no repair's is refused before any file is read.
int RunFix(const std::vector<std::string>& arguments, const FixOptions& fix, const SaveOptions& options,
           EditOptions edit, const BatchOptions& batch, std::ostream& out, std::ostream& err);
