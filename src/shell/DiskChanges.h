// SPDX-License-Identifier: MIT
#pragma once

#include <string>

#include "HeaderData.h"

class Dialogs;

// What another program did to the open part while the window edits it.

// How the file named by path stands on disk now (its inode, size and change time); empty when
// nothing has the name. Two equal marks: nothing happened in between.
std::string DiskMark(const std::string& path);

// True when a file has the part's name and it is not the part as it was read or last saved.
bool ChangedOnDisk(const HeaderData& header);

// "<path> was changed by another program. Reload it and lose your changes?": Yes reloads, No keeps
// editing; Reload is the default only while the document has no change of its own.
bool AskToReload(const HeaderData& header, Dialogs& dialogs);
