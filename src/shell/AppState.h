// SPDX-License-Identifier: MIT
#pragma once

#include <string>

#include "HeaderData.h"
#include "Preferences.h"
#include "RecentFiles.h"
#include "StandardLists.h"

class Clock;
class Dialogs;
class SettingsStore;

// Everything the program knows during a run, created once by main and handed to whoever needs it.
struct AppState {
    HeaderData Header; // with the document flags FileChanged, FileLoaded, Loading
    StandardLists Lists;
    Preferences Prefs;
    RecentFilesMenu Recent;
    std::string PendingFile;     // a path the Open command opens instead of asking
    std::string ProgramFolder;   // where the list files live
    std::string FirstOpenFolder; // the Open dialog's folder until "LastPath" is stored; empty: ProgramFolder
};

// What the program talks to outside itself.
struct Services {
    SettingsStore& store;
    Dialogs& dialogs;
    const Clock& clock;
};
