// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "HeaderData.h"

// Where on disk a line lies that a check names, counted as editors count lines (a line ends at
// CR LF, LF or CR). The checks see the text a save would write, whose composed header may have
// more or fewer lines than the file's, in another order; and the Parts Tracker's rules count a
// few more line breaks than editors do.
class FileLinePlaces {
public:
    FileLinePlaces(const HeaderData& header, const std::string& composedHeader);

    // The file's line of the line the Tracker's rules count as number checkedLine (from 1) of
    // the text a save would write; 0 when the file has no such line, as for a header line the
    // composer adds. Cheapest when asked in ascending order.
    std::size_t ofCheckedLine(std::size_t checkedLine) const;
    // The file's first header line with the keyword ("!LICENSE", "Author:"; "" for the
    // description's line); 0 when it has none.
    std::size_t ofHeaderKeyword(std::string_view keyword) const;
    // The header line a finding of the Parts Tracker's rule id concerns ("license.approved": the
    // licence line); 0 when the rule is about no one header line or the file lacks it.
    std::size_t ofTrackerRule(std::string_view id) const;

private:
    // Where the walk through the text a save would write stands: the checked line that starts a
    // CR LF line of the composed header or the body.
    struct Walk {
        bool inBody = false;
        std::size_t offset = 0;      // of the CR LF line in its piece
        std::size_t lineIndex = 0;   // of the CR LF line in its piece
        std::size_t checkedLine = 1; // the checked line it starts with
    };
    std::size_t ofOldHeaderLine(std::size_t index, std::size_t linesWithin) const;
    std::size_t ofComposedLine(std::size_t index, std::size_t linesWithin) const;
    std::size_t editorLine(std::size_t readerLine, std::size_t linesWithin) const;
    std::size_t lineFeedsBefore(std::size_t readerLine) const;

    const HeaderData& header_;
    const std::string& composed_;
    mutable Walk walk_;
    // Each line of the file that holds LF alone, which editors end a line at and the parser does
    // not: its line as the parser counts it, and the LFs within it and all the lines before.
    mutable std::optional<std::vector<std::pair<std::size_t, std::size_t>>> lineFeeds_;
};
