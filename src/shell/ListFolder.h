// SPDX-License-Identifier: MIT
#pragma once

#include <string>

// The folder the four list files are read from and written to: beside the program when all four
// stand there (a build folder, a portable copy), exactly as always. Otherwise userFolder, where a
// list that is missing is first copied from defaultsFolder, the installed defaults, which are
// never written. A copy the user has not edited since it was made is replaced when the installed
// default has changed since (an upgrade brought new entries); an edited copy is never touched.
// Nothing is reported here: a list that could not be had is reported when it is loaded, as a
// missing list file always was.
std::string ListFolderFor(const std::string& programFolder, const std::string& userFolder,
                          const std::string& defaultsFolder);

// The same for this program: the user's folder is "Quillmark" in the per-user data folder, the
// defaults are the installed ones beside the program's install folder.
std::string ListFolderOfThisProgram(const std::string& programFolder);

// The folder the Open dialog starts in until "LastPath" is stored: the program's folder when
// the lists stand there, the user's home otherwise.
std::string FirstOpenFolder(const std::string& programFolder, const std::string& listFolder);

// A data file the program only reads (not a list the user edits): beside the program when it
// stands there, else among the installed defaults.
std::string DataFileOfThisProgram(const std::string& programFolder, const std::string& name);
