// SPDX-License-Identifier: MIT
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

// Both fraction rules look at the digits after a dot.
void checkFraction(std::string_view text, std::size_t dot, bool& precisionDecided, NumberFormatFindings& found)
{
    const auto fraction = digitsFrom(text, dot + 1);
    const auto end = dot + 1 + fraction;
    if (!precisionDecided && fraction >= 5) {
        precisionDecided = true;
        found.tooPrecise = fraction >= 6 ? wordAround(text, dot) : std::string_view();
    }
    if (found.trailingZero.empty() && fraction > 0 && text[end - 1] == '0' &&
        (end == text.size() || isBlankByte(text[end])))
        found.trailingZero = wordAround(text, dot);
}

// A word with a leading zero starts with "0" and a digit, or "-0" and a digit, at i.
void checkLeadingZero(std::string_view text, std::size_t i, NumberFormatFindings& found)
{
    const auto start = i > 0 && text[i - 1] == '-' ? i - 1 : i;
    if (start > 0 && !isBlankByte(text[start - 1]))
        return;
    auto end = i;
    while (end < text.size() && !isBlankByte(text[end]))
        ++end;
    if (end < text.size() && hasLeadingZero(text.substr(start, end - start)))
        found.leadingZero = text.substr(start, end - start);
}

} // namespace

NumberFormatFindings CheckNumberFormats(std::string_view text)
{
    NumberFormatFindings found;
    bool precisionDecided = false;
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (text[i] == '.')
            checkFraction(text, i, precisionDecided, found);
        else if (text[i] == '0' && found.leadingZero.empty() && i + 1 < text.size() && isDigit(text[i + 1]))
            checkLeadingZero(text, i, found);
    }
    return found;
}
