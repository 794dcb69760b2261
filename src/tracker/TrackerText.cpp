// SPDX-License-Identifier: MIT
#include "TrackerText.h"

#include <QChar>
#include <algorithm>
#include <array>

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
    const auto slashes = line.find_first_not_of(" \t", 1);
    return line.substr(slashes, 2) == "//" && line.find_first_not_of(" \t", slashes + 2) == std::string_view::npos;
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
    for (const auto size = text_.size(); pos_ < size; ++pos_) {
        const auto kind = kinds[bytes[pos_]];
        if ((kind & MayBreak) != 0 && (breakLength = BreakLength(text_.substr(pos_))) != 0)
            break;
        seen |= kind | ((kind & previous & Space) != 0 ? NotPlain : 0);
        previous = kind;
    }
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
