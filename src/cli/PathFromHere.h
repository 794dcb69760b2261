// SPDX-License-Identifier: MIT
#pragma once

#include <string>

// The file a path names as a save writes it (links followed, "." and ".." gone), from the
// current folder: relative when it lies below the current folder, else absolute.
struct PathFromHere {
    std::string path;
    bool belowHere = false;
};

PathFromHere SavedPathFromHere(const std::string& path);

// The same from folder instead of the current folder.
PathFromHere SavedPathFrom(const std::string& path, const std::string& folder);
