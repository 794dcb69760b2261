// SPDX-License-Identifier: MIT
#pragma once

#include <ostream>
#include <string>
#include <vector>

class ConsoleDialogs;

// fields: one JSON line per file with the record as opened.
int RunFields(const std::vector<std::string>& paths, ConsoleDialogs& dialogs, std::ostream& out, std::ostream& err);

// print: exactly the bytes that saving would write right after the open.
int RunPrint(const std::string& path, ConsoleDialogs& dialogs, std::ostream& out, std::ostream& err);
