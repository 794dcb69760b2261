// SPDX-License-Identifier: MIT
#pragma once

#include <mutex>
#include <set>
#include <string>
#include <string_view>

// The two names of the diff of the file at path, for patch -p1 run in the current folder: the
// path of the file a save writes (links followed, "." and ".." gone) after "a/" and "b/". A file
// outside the current folder has its absolute path in both, and applies is false.
//
// Names are written as git writes them, so that patch reads them back byte for byte: in double
// quotes with C escapes when they hold a blank at an end, a tab, a newline, a quote, a backslash
// or another control character; followed by a tab when they hold a blank inside, which would
// otherwise end the name for patch.
struct DiffNames {
    std::string from, to;
    bool applies = true;
};
DiffNames DiffNamesOf(const std::string& path);

// The files a dry run has shown a diff of. A file named twice, or by a link and by its own name,
// gets one diff, as patch applies a diff once. Safe to use from several threads.
class DiffedFiles {
public:
    bool firstTime(const std::string& name);

private:
    std::mutex mutex_;
    std::set<std::string> names_;
};

// What a dry run prints for the file at path, which holds before and would hold after: their diff
// under the names above, unless diffed has had it. For a file outside the current folder, says on
// note that patch -p1 cannot apply it from here.
std::string DryRunDiff(const std::string& path, std::string_view before, std::string_view after, DiffedFiles& diffed,
                       std::string& note);
