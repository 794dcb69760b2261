// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

#include "LineReader.h"

// Reads the lines of a CR LF text and builds the body at the front of the very string that holds
// the text, so that a file's bytes become its body without a second copy of them. Each kept line
// is trimmed and joined to the body by CR LF; trimming only ever shortens, so the body never
// reaches the text still to be read. Lines that need no trimming are moved in runs, not one by
// one.
//
// A CR alone ends a line with one byte less than the CR LF that joins the body. Should such lines
// let the body catch up with the text still to be read, the rest of the text is moved back once,
// its line ends widened to CR LF, and the body goes on from there.
class InPlaceBody {
public:
    explicit InPlaceBody(std::string& text) : text_(text), reader_(text) {}
    InPlaceBody(const InPlaceBody&) = delete;
    InPlaceBody& operator=(const InPlaceBody&) = delete;

    bool atEnd() const { return reader_.atEnd(); }
    // The next line of the text. The view is valid until the next call of nextLine or keep.
    std::string_view nextLine()
    {
        const auto line = reader_.nextLine();
        if (reader_.position() > checkedUpTo_)
            checkAhead();
        if (reader_.position() > releasedUpTo_ + ReleaseStep)
            releaseReadPages(offsetOf(line));
        return line;
    }
    // Whether the text read so far is UTF-8: a text is checked as it is read, before any of it is
    // moved, a piece at a time that stays in the cache for the line reader.
    bool utf8() const { return checkedUpTo_ != NotUtf8; }
    std::size_t remainingBytes() const { return reader_.remainingBytes(); }
    bool bodyEmpty() const { return written_ == 0 && runEnd_ == NoRun; }

    // Adds the line that nextLine returned last, trimmed, to the body. Most lines just lengthen
    // the run before them.
    void keep(std::string_view line)
    {
        const auto start = offsetOf(line);
        if (runEnd_ != NoRun && continuesRun(start) && mayJoinRun(line) && runEnd_ - runStart_ < CachedRun)
            runEnd_ = start + line.size();
        else
            startPiece(line);
    }

    // Adds the lines from the reader's position on that need no trimming to the run that the line
    // kept last began, many at a time; returns how many. Most of a body goes this way.
    std::size_t keepPlainLines();

    // The string cut to the body; the text is gone. A body much shorter than the text is moved
    // into a buffer of its own size, so that the text's memory is given back.
    std::string take();

private:
    std::size_t offsetOf(std::string_view line) const { return static_cast<std::size_t>(line.data() - text_.data()); }
    // A line joins a run when it needs no trimming; an empty line only after text, since an empty
    // line adds nothing to an empty body.
    bool mayJoinRun(std::string_view line) const
    {
        return line.empty() ? !bodyEmpty() : line.front() != ' ' && line.back() != ' ';
    }
    // Lines end with CR LF or with a CR alone: two bytes between the run and the line are a CR LF.
    bool continuesRun(std::size_t start) const { return start == runEnd_ + 2; }
    void startPiece(std::string_view line);
    void checkAhead();
    void releaseReadPages(std::size_t lineStart);
    std::size_t separatorSize() const { return written_ == 0 ? 0 : 2; }
    std::size_t roomFor(std::size_t start);
    void append(std::string_view piece);
    void flush();

    static constexpr std::size_t NoRun = static_cast<std::size_t>(-1);
    static constexpr std::size_t NotUtf8 = static_cast<std::size_t>(-1);
    static constexpr std::size_t CheckedAll = NotUtf8 - 1;
    // Lines read one by one are checked a page ahead; keepPlainLines checks as it goes.
    static constexpr std::size_t CheckedPiece = 4096;
    // A header of many megabytes is copied out line by line: the pages read meanwhile that the
    // body does not reach are given back every few megabytes.
    static constexpr std::size_t ReleaseStep = std::size_t{8} * 1024 * 1024;
    // A run is moved while the bytes just read are still in the cache.
    static constexpr std::size_t CachedRun = std::size_t{64} * 1024;

    std::string& text_;
    LineReader reader_;
    std::size_t written_ = 0;     // the body's length
    std::size_t checkedUpTo_ = 0; // the text before this is UTF-8
    std::size_t releasedUpTo_ = 0;
    std::size_t runStart_ = 0;
    std::size_t runEnd_ = NoRun;
};
