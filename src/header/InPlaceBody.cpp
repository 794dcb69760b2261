#include "InPlaceBody.h"

#include <cstring>

#include "LineEnds.h"
#include "Text.h"

void InPlaceBody::keep(std::string_view line)
{
    auto start = static_cast<std::size_t>(line.data() - text_.data());
    if (runEnd_ != NoRun && continuesRun(start) && mayJoinRun(line) && runEnd_ - runStart_ < CachedRun) {
        runEnd_ = start + line.size();
        return;
    }
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

std::string InPlaceBody::take()
{
    flush();
    const auto textSize = text_.size();
    text_.resize(written_);
    if (written_ < textSize / 2)
        text_.shrink_to_fit();
    return std::move(text_);
}

// A line joins a run when it needs no trimming; an empty line only after text, since an empty
// line adds nothing to an empty body.
bool InPlaceBody::mayJoinRun(std::string_view line) const
{
    return line.empty() ? !bodyEmpty() : line.front() != ' ' && line.back() != ' ';
}

// Lines end with CR LF or with a CR alone: two bytes between the run and the line are a CR LF.
bool InPlaceBody::continuesRun(std::size_t start) const { return start == runEnd_ + 2; }

// Where the line that starts at start can be taken from: there, when the body and its separator
// end before it; otherwise the rest of the text is moved back far enough, with every line end
// widened to CR LF, after which no later line can be caught up with.
std::size_t InPlaceBody::roomFor(std::size_t start)
{
    const auto bodyEnd = written_ + separatorSize();
    if (bodyEnd <= start)
        return start;
    const auto gap = bodyEnd - start;
    WidenLoneCrs(text_, start, gap);
    reader_ = LineReader(text_, start + gap);
    reader_.nextLine();
    return start + gap;
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
