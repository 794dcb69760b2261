#pragma once

#include <string>

#include "AppState.h"

// The record's side of opening a file; the window does the rest (clearing and filling itself).

// From start-up's point of view: flags, starting folder, recent files and lists.
void StartUpState(AppState& app, Services& services);

// The reset at the start of an open: Loading on, the record emptied, the standard lists and the
// preference defaults read again.
void BeginOpen(AppState& app, Services& services);

// A path taken as the file to open (command line, drop, Open dialog): path, name and folder, the
// folder stored as "LastPath", FileLoaded on, FileChanged off.
void LadeDATDateiCommandLine(AppState& app, const std::string& path, Services& services);

// A path from the recent-files menu: the same, but "LastPath" stays as it is.
void TakeRecentFile(AppState& app, const std::string& path, Services& services);

// The window's caption: the base title, and " [name]" while a file is open.
std::string CaptionFor(const std::string& baseTitle, const std::string& partName);
