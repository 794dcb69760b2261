// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <string_view>
#include <vector>

// How the client and the server count the characters of a line: the protocol's default is
// UTF-16 code units; UTF-8 bytes when both agree on it.
enum class PositionEncoding { Utf16, Utf8 };

// A place in a text as the protocol names it: a line (from 0) and a character within it.
struct TextPosition {
    std::size_t line = 0, character = 0;
    bool operator==(const TextPosition&) const = default;
};

// The lines of a text as the protocol counts them: a line ends at CR LF, LF or CR. Holds only the
// lines' starts; the text is given again to each question and must be the one it was built from.
class LineIndex {
public:
    explicit LineIndex(std::string_view text);

    std::size_t lineCount() const { return starts_.size(); }
    // The byte where a line starts, and where its content ends (before its line end).
    std::size_t lineStart(std::size_t line) const { return starts_[line]; }
    std::size_t contentEnd(std::string_view text, std::size_t line) const;

    // The byte offset of a position. A line past the last is the end of the text; a character
    // past the line's end is the line's end (as the protocol asks), one inside a character that
    // takes two units the character's start.
    std::size_t offsetOf(std::string_view text, TextPosition position, PositionEncoding encoding) const;
    // The position of a byte offset (at most the text's size).
    TextPosition positionOf(std::string_view text, std::size_t offset, PositionEncoding encoding) const;

private:
    std::vector<std::size_t> starts_;
};
