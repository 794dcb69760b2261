// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <string_view>

// The words of a header line: split at every blank, so two blanks in a row give an empty word
// between them and a leading blank gives an empty first word; blanks at the very end give no
// words. Words are counted from 1.
//
// Nothing is stored per word, so a line of a million blanks costs no more memory than a short
// one; reading the words in order is as cheap as splitting them once.
class Words {
public:
    explicit Words(std::string_view line = {});

    std::size_t count() const { return count_; }
    // Word position (1 to count); the view points into the line.
    std::string_view word(std::size_t position) const;
    // The words from position k joined by single blanks; empty words before the first non-empty
    // one are skipped, later empty words keep their blank. The view points into the line.
    std::string_view joinedFrom(std::size_t k) const;

private:
    std::size_t startOf(std::size_t position) const;

    std::string_view text_;
    std::size_t count_ = 0;
    // Where the last word asked for starts, so that reading the words in order never rescans.
    mutable std::size_t cursorPosition_ = 1;
    mutable std::size_t cursorOffset_ = 0;
};
