// SPDX-License-Identifier: MIT
#include "TrackerText.h"

#include <QChar>
#include <algorithm>
#include <array>
#include <bit>
#ifdef __SSE2__
#include <emmintrin.h>
#endif

namespace {

unsigned char byteAt(std::string_view text, std::size_t i) { return static_cast<unsigned char>(text[i]); }

// The code point of the UTF-8 sequence at the start of text and its length; 0 when there is none.
std::size_t decode(std::string_view text, char32_t& code)
{
    const auto lead = byteAt(text, 0);
    const std::size_t length = lead >= 0xF0 ? 4 : lead >= 0xE0 ? 3 : lead >= 0xC0 ? 2 : 0;
    if (length == 0 || text.size() < length)
        return 0;
    code = lead & (0x7F >> length);
    for (std::size_t i = 1; i < length; ++i)
        code = (code << 6) | (byteAt(text, i) & 0x3F);
    return length;
}

bool isLineEmptiedByTheTracker(std::string_view line)
{
    if (line == "0")
        return true;
    if (line.size() < 4 || line[0] != '0' || (line[1] != ' ' && line[1] != '\t'))
        return false;
    const auto slashes = line.find_first_not_of(" \t", 1); // none in "0" and blanks, a line the Tracker keeps
    return slashes != std::string_view::npos && line.substr(slashes, 2) == "//" &&
           line.find_first_not_of(" \t", slashes + 2) == std::string_view::npos;
}

constexpr std::size_t Block = 16;

struct PlainRun {
    std::size_t length = 0;   // the bytes from the start that are neither controls nor above 127
    bool doubleSpace = false; // two spaces in a row among them (or the last and the byte after it)
};

// The run of ordinary bytes among the 16 at p, which neither end a line nor make it other than
// plain but by two spaces in a row. Reads 17 bytes.
PlainRun plainRunIn(const char* p)
{
    PlainRun run;
#ifdef __SSE2__
    const auto here = _mm_loadu_si128(reinterpret_cast<const __m128i*>(p));
    const auto next = _mm_loadu_si128(reinterpret_cast<const __m128i*>(p + 1));
    // As signed bytes, those above 127 are negative: below 14 are both them and the controls.
    const auto stops = static_cast<unsigned>(_mm_movemask_epi8(_mm_cmplt_epi8(here, _mm_set1_epi8(14))));
    const auto space = _mm_set1_epi8(' ');
    const auto pairs = static_cast<unsigned>(
        _mm_movemask_epi8(_mm_and_si128(_mm_cmpeq_epi8(here, space), _mm_cmpeq_epi8(next, space))));
    run.length = stops == 0 ? Block : static_cast<std::size_t>(std::countr_zero(stops));
    run.doubleSpace = (pairs & ((1u << run.length) - 1)) != 0;
#else
    while (run.length < Block && static_cast<unsigned char>(p[run.length]) >= 14 &&
           static_cast<unsigned char>(p[run.length]) < 0x80) {
        run.doubleSpace = run.doubleSpace || (p[run.length] == ' ' && p[run.length + 1] == ' ');
        ++run.length;
    }
#endif
    return run;
}

} // namespace

std::size_t BlankLength(std::string_view text)
{
    if (text.empty())
        return 0;
    const auto c = byteAt(text, 0);
    if (c == ' ' || c == '\t')
        return 1;
    if (c < 0x80)
        return 0;
    char32_t code = 0;
    const auto length = decode(text, code);
    const bool blank = code == 0xA0 || code == 0x1680 || code == 0x180E || (code >= 0x2000 && code <= 0x200A) ||
                       code == 0x202F || code == 0x205F || code == 0x3000;
    return blank ? length : 0;
}

std::size_t DigitLength(std::string_view text)
{
    if (text.empty())
        return 0;
    const auto c = byteAt(text, 0);
    if (c < 0x80)
        return c >= '0' && c <= '9' ? 1 : 0;
    char32_t code = 0;
    const auto length = decode(text, code);
    return length != 0 && QChar::category(code) == QChar::Number_DecimalDigit ? length : 0;
}

std::size_t BreakLength(std::string_view text)
{
    if (text.empty())
        return 0;
    switch (byteAt(text, 0)) {
    case '\r': return text.size() > 1 && text[1] == '\n' ? 2 : 1;
    case '\n':
    case '\v':
    case '\f': return 1;
    case 0xC2: return text.size() > 1 && byteAt(text, 1) == 0x85 ? 2 : 0;
    case 0xE2:
        return text.size() > 2 && byteAt(text, 1) == 0x80 && (byteAt(text, 2) == 0xA8 || byteAt(text, 2) == 0xA9) ? 3
                                                                                                                  : 0;
    default: return 0;
    }
}

bool IsTrimmed(char c) { return c == ' ' || c == '\t' || c == '\n' || c == '\r' || c == '\0' || c == '\v'; }

std::string_view TrimTrackerLine(std::string_view text)
{
    std::size_t start = 0, end = text.size();
    while (start < end && IsTrimmed(text[start]))
        ++start;
    while (end > start && IsTrimmed(text[end - 1]))
        --end;
    return text.substr(start, end - start);
}

std::string_view CollapseBlanks(std::string_view text, std::string& buffer)
{
    auto& out = buffer;
    out.resize(text.size());
    char* to = out.data();
    const char* from = text.data();
    const char* const end = from + text.size();
    bool inBlank = false;
    while (from < end) {
        const auto c = static_cast<unsigned char>(*from);
        if (c > ' ' && c < 0x80) { // the common case: a visible ASCII character
            *to++ = *from++;
            inBlank = false;
            continue;
        }
        const auto blank = c == ' ' || c == '\t' ? 1 : BlankLength({from, static_cast<std::size_t>(end - from)});
        if (blank == 0) {
            *to++ = *from++;
            inBlank = false;
            continue;
        }
        if (!inBlank)
            *to++ = ' ';
        inBlank = true;
        from += blank;
    }
    out.resize(static_cast<std::size_t>(to - out.data()));
    return out;
}

TrackerLines::TrackerLines(std::string_view text) : text_(text)
{
    while (first_ < text.size() && IsTrimmed(text[first_]))
        ++first_;
    last_ = text.size();
    while (last_ > first_ && IsTrimmed(text[last_ - 1]))
        --last_;
}

bool TrackerLines::next(TrackerLine& line)
{
    if (done_)
        return false;
    const auto start = pos_;
    std::size_t breakLength = 0;
    // The bytes that can start a line break (the ASCII controls and the lead bytes of U+0085,
    // U+2028 and U+2029), and those that make a line other than plain: TAB, space and non-ASCII.
    enum : unsigned char { MayBreak = 1, NotPlain = 2, Space = 4 };
    static constexpr auto kinds = [] {
        std::array<unsigned char, 256> table{};
        for (int c = 0; c <= '\r'; ++c)
            table[static_cast<std::size_t>(c)] = MayBreak;
        for (int c = 0x80; c < 0x100; ++c)
            table[static_cast<std::size_t>(c)] = NotPlain;
        table['\t'] |= NotPlain;
        table[' '] = Space;
        table[0xC2] = table[0xE2] = MayBreak | NotPlain;
        return table;
    }();
    const auto* bytes = reinterpret_cast<const unsigned char*>(text_.data());
    unsigned char seen = 0, previous = 0;
    auto pos = pos_;
    for (const auto size = text_.size(); pos < size; ++pos) {
        // Most bytes are ordinary ones, passed over sixteen at a time.
        while (pos + Block + 1 <= size) {
            const auto run = plainRunIn(text_.data() + pos);
            if (run.length == 0)
                break;
            // A run never starts after a space it could pair with: a run of 16 that ends in one has
            // had the byte after it compared.
            if (run.doubleSpace)
                seen |= NotPlain;
            previous = kinds[bytes[pos + run.length - 1]];
            pos += run.length;
        }
        if (pos >= size)
            break;
        const auto kind = kinds[bytes[pos]];
        if ((kind & MayBreak) != 0 && (breakLength = BreakLength(text_.substr(pos))) != 0)
            break;
        seen |= kind | ((kind & previous & Space) != 0 ? NotPlain : 0);
        previous = kind;
    }
    pos_ = pos;
    line.plain = (seen & NotPlain) == 0;
    const auto end = pos_;
    pos_ += breakLength;
    done_ = pos_ >= text_.size();
    line.number = ++number_;
    // The Tracker trims the whole text before splitting it: the first and last lines lose their
    // outer blanks before it looks for the lines it empties.
    line.first = start <= first_ && first_ <= end && first_ < text_.size();
    const auto from = std::max(start, first_), to = std::min(end, last_);
    const auto raw = from < to ? text_.substr(from, to - from) : std::string_view();
    line.text = isLineEmptiedByTheTracker(raw) ? std::string_view() : TrimTrackerLine(raw);
    return true;
}
