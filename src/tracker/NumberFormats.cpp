#include "NumberFormats.h"

namespace {

bool isDigit(char c) { return c >= '0' && c <= '9'; }
bool isBlankByte(char c) { return c == ' ' || c == '\t' || c == '\xA0'; }

std::size_t digitsFrom(std::string_view text, std::size_t i)
{
    auto end = i;
    while (end < text.size() && isDigit(text[end]))
        ++end;
    return end - i;
}

// "-?0\d+(\.\d+)?", the whole word.
bool hasLeadingZero(std::string_view word)
{
    std::size_t i = !word.empty() && word[0] == '-' ? 1 : 0;
    if (i + 1 >= word.size() || word[i] != '0' || !isDigit(word[i + 1]))
        return false;
    i += 1 + digitsFrom(word, i + 1);
    if (i < word.size() && word[i] == '.' && digitsFrom(word, i + 1) > 0)
        i += 1 + digitsFrom(word, i + 1);
    return i == word.size();
}

} // namespace

NumberFormatFindings CheckNumberFormats(std::string_view text)
{
    NumberFormatFindings found;
    bool precisionDecided = false;
    for (std::size_t start = 0; start < text.size();) {
        auto end = start;
        auto firstDot = std::string_view::npos;
        for (; end < text.size() && !isBlankByte(text[end]); ++end)
            if (text[end] == '.' && firstDot == std::string_view::npos)
                firstDot = end;
        const auto word = text.substr(start, end - start);
        for (auto dot = firstDot; dot < end; ++dot) {
            if (text[dot] != '.')
                continue;
            const auto fraction = digitsFrom(text, dot + 1);
            if (!precisionDecided && fraction >= 5) {
                precisionDecided = true;
                found.tooPrecise = fraction >= 6 ? word : std::string_view();
            }
            if (found.trailingZero.empty() && fraction > 0 && dot + 1 + fraction == end && text[end - 1] == '0')
                found.trailingZero = word;
        }
        if (found.leadingZero.empty() && (word[0] == '0' || word[0] == '-') && end < text.size() &&
            hasLeadingZero(word))
            found.leadingZero = word;
        start = end;
        while (start < text.size() && isBlankByte(text[start]))
            ++start;
    }
    return found;
}
