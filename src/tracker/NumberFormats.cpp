#include "NumberFormats.h"

#include <cstring>

namespace {

bool isDigit(char c) { return c >= '0' && c <= '9'; }
// A blank in the Tracker's byte-wise reading: space, TAB or the byte 0xA0.
bool isBlankByte(char c) { return c == ' ' || c == '\t' || c == '\xA0'; }

std::size_t digitsFrom(std::string_view text, std::size_t i)
{
    auto end = i;
    while (end < text.size() && isDigit(text[end]))
        ++end;
    return end - i;
}

// The blank-delimited word around position i.
std::string_view wordAround(std::string_view text, std::size_t i)
{
    auto start = i, end = i;
    while (start > 0 && !isBlankByte(text[start - 1]))
        --start;
    while (end < text.size() && !isBlankByte(text[end]))
        ++end;
    return text.substr(start, end - start);
}

// The position of the next "." from i on, or the text's size.
std::size_t nextDot(std::string_view text, std::size_t i)
{
    if (i >= text.size())
        return text.size();
    const auto* dot = static_cast<const char*>(std::memchr(text.data() + i, '.', text.size() - i));
    return dot == nullptr ? text.size() : static_cast<std::size_t>(dot - text.data());
}

} // namespace

std::string_view TooPreciseNumber(std::string_view text)
{
    for (auto dot = nextDot(text, 0); dot < text.size(); dot = nextDot(text, dot + 1)) {
        const auto fraction = digitsFrom(text, dot + 1);
        if (fraction >= 5)
            return fraction >= 6 ? wordAround(text, dot) : std::string_view();
    }
    return {};
}

std::string_view NumberWithTrailingZero(std::string_view text)
{
    for (auto dot = nextDot(text, 0); dot < text.size(); dot = nextDot(text, dot + 1)) {
        const auto fraction = digitsFrom(text, dot + 1);
        const auto end = dot + 1 + fraction;
        if (fraction > 0 && text[end - 1] == '0' && (end == text.size() || isBlankByte(text[end])))
            return wordAround(text, dot);
    }
    return {};
}

std::string_view NumberWithLeadingZero(std::string_view text)
{
    for (std::size_t start = 0; start < text.size(); ++start) {
        while (start < text.size() && start > 0 && !isBlankByte(text[start - 1]))
            ++start;
        if (start >= text.size())
            break;
        auto i = start + (text[start] == '-' ? 1 : 0);
        if (i + 1 >= text.size() || text[i] != '0' || !isDigit(text[i + 1]))
            continue;
        if (i >= text.size() || text[i] != '0')
            continue;
        const auto more = digitsFrom(text, i + 1);
        if (more == 0)
            continue;
        i += 1 + more;
        if (i < text.size() && text[i] == '.' && digitsFrom(text, i + 1) > 0)
            i += 1 + digitsFrom(text, i + 1);
        if (i < text.size() && isBlankByte(text[i]))
            return text.substr(start, i - start);
    }
    return {};
}
