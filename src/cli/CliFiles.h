// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <ostream>
#include <string>
#include <vector>

#include "HeaderData.h"
#include "ListKinds.h"

#include "KeepFile.h"
#include "PartFile.h"
#include "PartFileList.h"
#include "SafeReplace.h"

class ColourSource;
class ConsoleDialogs;

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

// What the reads of one run share, found once and used by every thread: the memory figures and
// claims, and where keep files are looked for.
struct RunReads {
    MemoryClaims memory;
    KeepSearch keeps;
};

// Reads the open part as the Open command does; path names it in messages. A command that writes
// (writing: its run's sweeps and lock wait) first undoes what a killed save left there; when the
// part changed since, its copy stays and the file fails (status SaveFailed). A command that only
// reads writes nothing: a part that an interrupted save left torn is read as the restore would
// leave it, and said so. The file's bytes become the record's body: the file is in memory once.
// When the file cannot be read, says so in one line on err and returns nullopt with status
// Unreadable.
std::optional<HeaderData> ReadForCli(const std::shared_ptr<OpenPart>& part, const std::string& path,
                                     ConsoleDialogs& dialogs, std::ostream& err, const ReplaceOptions* writing,
                                     int& status, RunReads& reads);

// Opens and reads the file an entry names for a command that only reads (see ReadForCli).
std::optional<HeaderData> OpenForCli(const PartFileEntry& entry, ConsoleDialogs& dialogs, std::ostream& err,
                                     int& status, RunReads& reads);

// The folder of the running program, where a build keeps its list and data files.
std::string ProgramFolder();

// A standard list, from the list file the window uses. When it cannot be read, says so on err
// and returns false.
bool ReadStandardList(ListKind kind, StringList& entries, std::ostream& err);

// Where the Parts Tracker's colour codes come from, for check's --ldconfig (empty: search above
// each part); what is unusable is said on err. Null when the built-in list cannot be read.
std::unique_ptr<ColourSource> ColourSourceFor(const std::string& ldconfig, std::ostream& err);

// Runs handle on every file that opens and returns the worst status: Unreadable for a file that
// did not open, otherwise the largest that handle returned.
int ForEachOpenedFile(const std::vector<std::string>& paths, ConsoleDialogs& dialogs, std::ostream& err,
                      const std::function<int(HeaderData&)>& handle);
