// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <vector>

// Where the lines of a text taken from a file stand in that file, so that a message about a line
// can name the line an editor opens. Lines that follow each other in both are kept as one run:
// a header of a million lines without blank lines between them costs one entry.
class FileLines {
public:
    // The text's next line stands on fileLine (counted from 1).
    void add(std::size_t fileLine)
    {
        if (runs_.empty() || runs_.back().fileLine + (count_ - runs_.back().first) != fileLine)
            runs_.push_back({count_, fileLine});
        ++count_;
    }
    // The file's line of the text's line at index (from 0); the lines after the last one added
    // follow it line for line. 0 when the text has no line from the file there.
    std::size_t fileLineOf(std::size_t index) const;
    std::size_t size() const { return count_; } // the lines added
    void clear() { *this = {}; }

private:
    struct Run {
        std::size_t first;    // the run's first line in the text
        std::size_t fileLine; // where it stands in the file
    };
    std::vector<Run> runs_;
    std::size_t count_ = 0;
};
