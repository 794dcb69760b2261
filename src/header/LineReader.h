// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <cstdint>
#include <string_view>

// Reads a text line by line: a line ends at CR LF or at a lone CR, a lone LF stays inside the
// line, and the last line needs no line end. A text that ends with a line end has no empty
// line after it. The reader looks at the text; it copies nothing.
class LineReader {
public:
    // Reads text from position on.
    explicit LineReader(std::string_view text, std::size_t position = 0) : text_(text), position_(position) {}

    bool atEnd() const { return position_ >= text_.size(); }
    std::string_view nextLine()
    {
        const auto start = position_;
        const auto cr = nextCr(start);
        if (cr == text_.size()) {
            position_ = cr;
            return text_.substr(start);
        }
        position_ = cr + 1;
        if (position_ < text_.size() && text_[position_] == '\n')
            ++position_;
        return text_.substr(start, cr - start);
    }
    std::size_t remainingBytes() const { return text_.size() - position_; }
    // Where the next line starts.
    std::size_t position() const { return position_; }

    // What skipPlainLines passed: how many lines, and up to where the text is known to hold no
    // byte above 127 that was not known to be checked before.
    struct PlainLines {
        std::size_t count = 0;
        std::size_t checkedUpTo = 0;
    };
    // Passes over the lines from here on that are kept as they stand: lines ended by CR LF that
    // neither begin nor end with a blank. Stops before the first other line, before 64 bytes that
    // hold a byte above 127 not before checkedUpTo (which must not lie before the position), and
    // once at least enough bytes are passed. The last bytes of the text are left to nextLine.
    PlainLines skipPlainLines(std::size_t checkedUpTo, std::size_t enough);

private:
    // Part-file lines are short, so the search for their end is set up once per 64 bytes rather
    // than once per line.
    static constexpr std::size_t Block = 64;

    // The first CR at or after from, or the text's size. Lines are read in order, so the CRs of
    // the block are taken one after the other, without looking at where the line starts.
    std::size_t nextCr(std::size_t from)
    {
        if (from < block_ || from >= block_ + Block) {
            loadBlock(from - from % Block);
            crs_ &= ~std::uint64_t{0} << (from - block_);
        }
        while (crs_ == 0) {
            if (block_ + Block >= text_.size())
                return text_.size();
            loadBlock(block_ + Block);
        }
        const auto cr = block_ + static_cast<std::size_t>(__builtin_ctzll(crs_));
        crs_ &= crs_ - 1;
        return cr;
    }

    // Finds the CRs among the 64 bytes from block on (bytes past the text count as none).
    void loadBlock(std::size_t block);

    std::string_view text_;
    std::size_t position_ = 0;
    std::size_t block_ = static_cast<std::size_t>(-1);
    std::uint64_t crs_ = 0; // one bit for each CR of the block not read yet
};
