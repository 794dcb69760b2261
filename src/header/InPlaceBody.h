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
    std::string_view nextLine() { return reader_.nextLine(); }
    std::size_t remainingBytes() const { return reader_.remainingBytes(); }

    // Adds the line that nextLine returned last, trimmed, to the body.
    void keep(std::string_view line);

    // The string cut to the body; the text is gone. A body much shorter than the text is moved
    // into a buffer of its own size, so that the text's memory is given back.
    std::string take();

private:
    bool bodyEmpty() const { return written_ == 0 && runEnd_ == NoRun; }
    bool mayJoinRun(std::string_view line) const;
    bool continuesRun(std::size_t start) const;
    std::size_t separatorSize() const { return written_ == 0 ? 0 : 2; }
    std::size_t roomFor(std::size_t start);
    void append(std::string_view piece);
    void flush();

    static constexpr std::size_t NoRun = static_cast<std::size_t>(-1);
    // A run is moved while the bytes just read are still in the cache.
    static constexpr std::size_t CachedRun = 64 * 1024;

    std::string& text_;
    LineReader reader_;
    std::size_t written_ = 0; // the body's length
    std::size_t runStart_ = 0;
    std::size_t runEnd_ = NoRun;
};
