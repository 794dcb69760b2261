#pragma once

#include <string_view>

// Reads a text line by line: a line ends at CR LF or at a lone CR, a lone LF stays inside the
// line, and the last line needs no line end. A text that ends with a line end has no empty
// line after it. The reader looks at the text; it copies nothing.
class LineReader {
public:
    explicit LineReader(std::string_view text) : text_(text) {}

    bool atEnd() const { return position_ >= text_.size(); }
    std::string_view nextLine();
    std::size_t remainingBytes() const { return text_.size() - position_; }

private:
    std::string_view text_;
    std::size_t position_ = 0;
};
