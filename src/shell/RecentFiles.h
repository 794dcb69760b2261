// SPDX-License-Identifier: MIT
#pragma once

#include <array>
#include <string>

class SettingsStore;

// The recent-files items at the end of the File menu: item 0 is the separator (no caption), items 1 to 10
// show one path each. The window mirrors this model.
struct RecentFileItem {
    bool visible = false;
    std::string caption;
};

struct RecentFilesMenu {
    RecentFilesMenu();
    std::array<RecentFileItem, 11> MRecentFile;
    int MaxRecentFiles = 9;
};

// Fills the items from the store; nothing changes while "RecentFile1" is missing or empty.
void ShowRecentFiles(RecentFilesMenu& menu, const SettingsStore& store);

// True when one of the items 1 to MaxRecentFiles shows exactly path.
bool IsRecentFile(const RecentFilesMenu& menu, const std::string& path);

// Stores path as the newest entry; the oldest of the nine drops out.
void PushRecentFile(SettingsStore& store, const std::string& path, int maxRecentFiles);

// A path being opened: stored unless the menu shows it already (it does not move up), then shown.
void AddRecentFile(RecentFilesMenu& menu, SettingsStore& store, const std::string& path);
