// SPDX-License-Identifier: MIT
#pragma once

#include <string>

#include "HeaderData.h"

class Dialogs;
class ParseProgress;

// Takes path as the file being opened: FilePath, PartName and FileFolder from it, FileLoaded on,
// FileChanged off. Does not look at the disk.
void TakeFileToOpen(HeaderData& header, const std::string& path, Dialogs& dialogs);

// What the window does to the record once the parse has filled it: the real name box takes the
// parsed name, and TABs leave the description. True when TABs were removed.
bool FinishOpenedRecord(HeaderData& header, Dialogs& dialogs);

// Opens already read part-file content the way the Open command opens a file, without a window:
// reset, take the path, parse, finish. Used by the command-line tool. The content becomes the body.
void OpenPartFileContent(HeaderData& header, const std::string& path, std::string content, Dialogs& dialogs,
                         ParseProgress& progress);
