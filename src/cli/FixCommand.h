// SPDX-License-Identifier: MIT
#pragma once

#include <ostream>
#include <string>
#include <vector>

#include "CheckCommands.h"

// fix: the Parts Tracker's findings that have one correct repair, repaired after edit's changes,
// then saved as edit saves. only names the repairs to run (none: those on by default); a name that
// is no repair's is refused before any file is read.
int RunFix(const std::vector<std::string>& arguments, const std::vector<std::string>& only, const SaveOptions& options,
           EditOptions edit, const BatchOptions& batch, std::ostream& out, std::ostream& err);
