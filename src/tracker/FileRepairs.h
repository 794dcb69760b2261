// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <set>
#include <string>
#include <string_view>
#include <vector>

#include "HeaderData.h"
#include "TrackerFixes.h"

// Repairs as edits of the file as it stands: what fix writes and a language server's quick fixes
// offer. Line ends, blanks, line order and every line without a repaired finding stay byte for byte.

// The bytes [begin, end) of the file as read give way to replacement.
struct TextEdit {
    std::size_t begin = 0, end = 0;
    std::string replacement;
};

// bytes with the edits made; edits ascend and do not overlap (two insertions may share a place).
std::string ApplyEdits(std::string_view bytes, const std::vector<TextEdit>& edits);

// What one repair, or the header edits asked for, changed.
struct FileRepair {
    std::string id;                 // the Tracker's id of the finding it clears; "" for the edits asked for
    std::vector<std::size_t> lines; // the lines on disk it changed or added, ascending
    int fixed = 0;                  // the findings it cleared
    int numbers = 0;                // the numbers or colours it rewrote, for the repairs of body lines
    std::vector<std::string> left;  // why it left a finding
};

struct FileRepairs {
    std::vector<TextEdit> edits;     // of the file as read
    std::vector<FileRepair> repairs; // in the order they ran
    std::string left;                // not empty: why the file is left as it is
};

// The edits that make of bytes, which read was parsed from, the file with edited's header (read
// with the header edits asked for) and the repairs named in chosen. A file with a finding that
// stops the Tracker's other rules ("missing", "authorinvalid"), or with an edit of the header that
// is no change, addition or removal of a single line or an added history line, is left.
FileRepairs RepairsOf(std::string_view bytes, const HeaderData& read, const HeaderData& edited,
                      const std::set<std::string>& chosen, const FixContext& context);
