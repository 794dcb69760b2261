// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <optional>
#include <ostream>
#include <string>
#include <vector>

#include "HeaderData.h"
#include "ListKinds.h"

class ConsoleDialogs;
class FolderSweeps;

// Exit statuses shared by the commands; a larger one wins when several apply.
namespace ExitStatus {
inline constexpr int Ok = 0;
inline constexpr int Refused = 1;
inline constexpr int Unreadable = 2;
inline constexpr int Usage = 2; // the command line itself is wrong
inline constexpr int SaveFailed = 3;
} // namespace ExitStatus

// The one line that names a file that could not be read or worked on.
void ReportUnreadable(const std::string& path, const std::exception& failure, std::ostream& err);

// Opens path as the Open command does; with restoreWith (see ReplaceOptions::sweeps), after undoing
// what a killed save left there, as a command that writes does first. The file's bytes become the
// record's body: the file is in memory once. When the file cannot be read, says so in one line on
// err and returns nullopt.
std::optional<HeaderData> OpenForCli(const std::string& path, ConsoleDialogs& dialogs, std::ostream& err,
                                     FolderSweeps* restoreWith = nullptr);

// The folder of the running program, where a build keeps its list and data files.
std::string ProgramFolder();

// A standard list, from the list file the window uses. When it cannot be read, says so on err
// and returns false.
bool ReadStandardList(ListKind kind, StringList& entries, std::ostream& err);

// Runs handle on every file that opens and returns the worst status: Unreadable for a file that
// did not open, otherwise the largest that handle returned.
int ForEachOpenedFile(const std::vector<std::string>& paths, ConsoleDialogs& dialogs, std::ostream& err,
                      const std::function<int(HeaderData&)>& handle);
