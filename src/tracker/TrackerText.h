// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

// The characters and lines of a part file as the Parts Tracker reads them, over UTF-8 bytes.
// "Blank" is horizontal whitespace in the Unicode sense (TAB, space, U+00A0, U+2000-U+200A, ...),
// "digit" a Unicode decimal digit.

// The byte length of the blank at the start of text, or 0.
std::size_t BlankLength(std::string_view text);
// The byte length of the digit at the start of text, or 0.
std::size_t DigitLength(std::string_view text);
// The same, quicker for ASCII text, which is all but every line of a part.
inline std::size_t DigitLengthAt(std::string_view text, std::size_t i)
{
    const auto c = static_cast<unsigned char>(text[i]);
    return c < 0x80 ? (c >= '0' && c <= '9' ? 1 : 0) : DigitLength(text.substr(i));
}
// The byte length of the line break at the start of text (CR LF, LF, CR, VT, FF, U+0085, U+2028,
// U+2029), or 0.
std::size_t BreakLength(std::string_view text);

// The characters the Tracker trims from the whole text and from each line: space, TAB, LF, CR,
// NUL and VT (a byte order mark and U+00A0 stay).
bool IsTrimmed(char c);
std::string_view TrimTrackerLine(std::string_view text);

// text with every run of blanks as one space, in buffer.
std::string_view CollapseBlanks(std::string_view text, std::string& buffer);

struct TrackerLine {
    int number = 0;        // counted from 1 in the checked text
    bool first = false;    // the Tracker's line 1: the first line of the text once it is trimmed
    std::string_view text; // trimmed; empty for a blank line
    bool plain = false;    // ASCII without TABs or two spaces in a row: its blanks need no collapsing
};

// Hands out the lines of a UTF-8 text one by one, with the lines the Tracker empties ("0",
// "0 //") empty, and without allocating.
class TrackerLines {
public:
    explicit TrackerLines(std::string_view text);
    bool next(TrackerLine& line);

private:
    std::string_view text_;
    std::size_t pos_ = 0, first_ = 0, last_ = 0;
    int number_ = 0;
    bool done_ = false;
};
