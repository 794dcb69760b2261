// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "HeaderData.h"
#include "TrackerCheck.h"

// Where on disk a finding lies: what the command line prints, the window shows and a language
// server turns into its ranges, computed once here from the file's bytes as read.
//
// Lines are counted as the editors and tools that open "path:line:col" count them (Vim, Emacs,
// grep, diff): a line ends at LF, CR LF included; a lone CR stays inside its line as a character.
// Columns count bytes from 1. The byte range is the authority for any other counting (a language
// server's UTF-16 positions, where a lone CR ends a line).
struct FindingPlace {
    bool wholeFile = true;  // about the file as a whole: line 1, column 1, an empty range at 0
    std::size_t line = 1;   // from 1
    std::size_t column = 1; // from 1: the first byte of the number or word the finding is about, else 1
    std::size_t begin = 0;  // the bytes [begin, end) of the file the finding is about: the number,
    std::size_t end = 0;    // the word, the header line's value, or the whole line without its end
};

// The key of a header line: "" for the description's (the header's first line), else its keyword
// as the parser takes it ("LICENSE" for "!LICENSE", "NAME:", "LDRAW_ORG" for "!LDRAW"); "#" for
// a blank line.
std::string HeaderLineKey(std::string_view line, bool first);
// What follows a header line's keyword (the "0" of the description's line), without the blanks
// around it; a view into line, empty when nothing follows.
std::string_view HeaderLineValue(std::string_view line, bool first);

// The places of one file's findings. The checks read the text a save would write, whose header is
// composed anew; a header line is placed where the same line, or else the first line with its
// keyword, stands in the file.
class FindingPlaces {
public:
    // fileBytes: the file as read, which header was parsed from; composedHeader: what the checks saw.
    FindingPlaces(std::string_view fileBytes, const HeaderData& header, const std::string& composedHeader);

    std::string_view bytes() const { return bytes_; }

    // A finding of the Parts Tracker's rules. Cheapest when asked in ascending order of lines.
    FindingPlace of(const TrackerFinding& finding) const;
    // The value of the file's first header line with the keyword ("!LICENSE", "Author:"; "" for the
    // description's line); the whole file when it has none.
    FindingPlace ofHeaderKeyword(std::string_view keyword) const;
    // The header line a finding of the rule id is about ("license.approved": the licence line's
    // value); the whole file when the rule is about no one header line or the file lacks it.
    FindingPlace ofTrackerRule(std::string_view id) const;

    // The byte range [begin, end) of the line the parser counts as readerLine (from 1), without its
    // line end; begin == end == size for a line past the end.
    std::pair<std::size_t, std::size_t> readerLine(std::size_t readerLine) const;
    // The line the parser counts (from 1) that holds the byte at offset.
    std::size_t readerLineAt(std::size_t offset) const;
    // The place of bytes [begin, end) of the file.
    FindingPlace at(std::size_t begin, std::size_t end) const;

private:
    struct RecordLine {
        std::size_t readerLine = 0; // 0: no line of the file
        std::size_t within = 0;     // the Tracker's line breaks before it within that line
    };
    RecordLine ofCheckedLine(std::size_t checkedLine) const;
    RecordLine ofComposedLine(std::size_t index, std::size_t within) const;
    std::size_t readerLineOfKeyword(std::string_view keyword) const;
    FindingPlace valueOf(std::size_t readerLine, std::string_view keyword) const;
    FindingPlace ofLine(const TrackerFinding& finding, RecordLine line) const;
    const std::vector<std::size_t>& readerStarts() const;

    std::string_view bytes_;
    const HeaderData& header_;
    const std::string& composed_;
    // Where the walk through the checked text stands: the checked line that starts a CR LF line of
    // the composed header or the body.
    struct Walk {
        bool inBody = false;
        std::size_t offset = 0;      // of the CR LF line in its piece
        std::size_t lineIndex = 0;   // of the CR LF line in its piece
        std::size_t checkedLine = 1; // the checked line it starts with
    };
    mutable Walk walk_;
    mutable std::vector<std::size_t> readerStarts_; // where each line the parser reads starts
    mutable std::vector<std::size_t> lineFeeds_;    // where each LF stands
    mutable bool tablesBuilt_ = false;
};
