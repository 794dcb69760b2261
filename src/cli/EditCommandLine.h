// SPDX-License-Identifier: MIT
#pragma once

#include <CLI/CLI.hpp>

#include "CheckCommands.h"

// The edit command's own options, each filling its field of edit.
void AddEditOptions(CLI::App& command, EditOptions& edit, bool& noCategory);

// The user an added history line names: the one given with --as, else the preferences' user name.
std::string HistoryUser(const std::string& given);

// The edits that can be checked before any file is touched: a user for an added history line,
// the values' forms (see EditValuesValid), values from a standard list. Says on err what is wrong.
bool EditsValid(const HeaderEdits& edits, std::ostream& err);
