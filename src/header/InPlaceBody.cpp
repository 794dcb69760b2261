// SPDX-License-Identifier: MIT
#include "InPlaceBody.h"

#include <algorithm>
#include <cstring>

#include "LargeBuffer.h"
#include "LineEnds.h"
#include "Text.h"

void InPlaceBody::startPiece(std::string_view line)
{
    auto start = offsetOf(line);
    flush();
    const bool startsRun = mayJoinRun(line);
    if (const auto movedTo = roomFor(start); movedTo != start) {
        start = movedTo;
        line = std::string_view(text_).substr(start, line.size());
    }
    if (startsRun) {
        runStart_ = start;
        runEnd_ = start + line.size();
    } else {
        append(TrimBlanks(line));
    }
}

std::size_t InPlaceBody::keepPlainLines()
{
    if (runEnd_ == NoRun || !continuesRun(reader_.position()) || runEnd_ - runStart_ >= CachedRun)
        return 0;
    const auto passed = reader_.skipPlainLines(checkedUpTo_, CachedRun - (runEnd_ - runStart_));
    if (passed.count != 0)
        runEnd_ = reader_.position() - 2;
    checkedUpTo_ = std::max(checkedUpTo_, passed.checkedUpTo);
    return passed.count;
}

std::string InPlaceBody::take()
{
    flush();
    const auto textSize = text_.size();
    text_.resize(written_);
    if (written_ < textSize / 2)
        text_.shrink_to_fit();
    return std::move(text_);
}

// Where the line that starts at start can be taken from: there, when the body and its separator
// end before it; otherwise the rest of the text is moved back far enough, with every line end
// widened to CR LF, after which no later line can be caught up with.
std::size_t InPlaceBody::roomFor(std::size_t start)
{
    const auto bodyEnd = written_ + separatorSize();
    if (bodyEnd <= start)
        return start;
    const auto gap = bodyEnd - start;
    if (utf8()) // the rest moves: check it where it is
        checkedUpTo_ = CheckUtf8(text_, checkedUpTo_, text_.size()) == NotUtf8 ? NotUtf8 : CheckedAll;
    WidenLoneCrs(text_, start, gap);
    reader_ = LineReader(text_, start + gap);
    reader_.nextLine();
    return start + gap;
}

void InPlaceBody::checkAhead()
{
    if (utf8())
        checkedUpTo_ = CheckUtf8(text_, checkedUpTo_, reader_.position() + CheckedPiece);
}

// Between the body (with the run not yet moved) and the line just read lie bytes that nothing
// reads again.
void InPlaceBody::releaseReadPages(std::size_t lineStart)
{
    const auto bodyEnd = runEnd_ == NoRun ? written_ : runEnd_;
    ReleaseLargeBufferPages(text_.data() + std::max(bodyEnd, releasedUpTo_), text_.data() + lineStart);
    releasedUpTo_ = lineStart;
}

// Writes the separator and piece at the end of the body; piece lies behind where it goes.
void InPlaceBody::append(std::string_view piece)
{
    const auto separator = separatorSize();
    if (!piece.empty()) // an empty view may point nowhere
        std::memmove(text_.data() + written_ + separator, piece.data(), piece.size());
    if (separator != 0)
        std::memcpy(text_.data() + written_, "\r\n", 2);
    written_ += separator + piece.size();
}

void InPlaceBody::flush()
{
    if (runEnd_ == NoRun)
        return;
    const auto run = std::string_view(text_).substr(runStart_, runEnd_ - runStart_);
    runEnd_ = NoRun;
    append(run);
}
