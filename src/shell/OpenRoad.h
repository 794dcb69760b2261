// SPDX-License-Identifier: MIT
#pragma once

#include <string>

#include "AppState.h"

class ParseProgress;

// The record's side of opening a file; the window does the rest (clearing and filling itself).

// From start-up's point of view: flags, starting folder, recent files and lists.
void StartUpState(AppState& app, Services& services);

// Where a path to open came from: the command line, a drop and the Open dialog store its folder
// as "LastPath"; the recent-files menu leaves "LastPath" as it is.
enum class OpenRoad { Chosen, Recent };

// Reads the part file at path into a record of its own. Only a file that opens as a part file
// becomes the document: it replaces the record (path, name and folder taken, FileLoaded on,
// FileChanged off, Loading on until the window is filled), the standard lists and preference
// defaults are read again, and the recent files and "LastPath" take it. A file that fails is
// reported and leaves the document, and everything else, as it was. True when it opened.
bool LadeDATDateiCommandLine(AppState& app, const std::string& path, OpenRoad road, Services& services,
                             ParseProgress& progress);

// The window's caption: the base title, and " [name]" while a file is open.
std::string CaptionFor(const std::string& baseTitle, const std::string& partName);
