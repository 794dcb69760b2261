// SPDX-License-Identifier: MIT
#include "NumberFormats.h"

#include <bit>
#include <cstring>
#ifdef __SSE2__
#include <emmintrin.h>
#endif

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

// The rules at position i: a fraction starts after a ".", a word with a leading zero at a "0"
// before a digit.
void checkAt(std::string_view text, std::size_t i, bool& precisionDecided, NumberFormatFindings& found)
{
    if (text[i] == '.')
        checkFraction(text, i, precisionDecided, found);
    else if (text[i] == '0' && found.leadingZero.empty() && i + 1 < text.size() && isDigit(text[i + 1]))
        checkLeadingZero(text, i, found);
}

constexpr std::size_t Block = 16;

// The positions among the 16 bytes at p where checkAt may find something, one bit each: each "."
// and each "0" before a digit. Reads 17 bytes.
unsigned placesToCheck(const char* p)
{
#ifdef __SSE2__
    const auto here = _mm_loadu_si128(reinterpret_cast<const __m128i*>(p));
    const auto next = _mm_loadu_si128(reinterpret_cast<const __m128i*>(p + 1));
    const auto digits =
        _mm_and_si128(_mm_cmpgt_epi8(next, _mm_set1_epi8('0' - 1)), _mm_cmplt_epi8(next, _mm_set1_epi8('9' + 1)));
    const auto places = _mm_or_si128(_mm_cmpeq_epi8(here, _mm_set1_epi8('.')),
                                     _mm_and_si128(_mm_cmpeq_epi8(here, _mm_set1_epi8('0')), digits));
    return static_cast<unsigned>(_mm_movemask_epi8(places));
#else
    unsigned places = 0;
    for (std::size_t k = 0; k < Block; ++k)
        places |= unsigned{p[k] == '.' || (p[k] == '0' && isDigit(p[k + 1]))} << k;
    return places;
#endif
}

} // namespace

// A line is mostly digits, blanks and signs: the rules look only at the few places that can start
// a finding, found sixteen bytes at a time.
NumberFormatFindings CheckNumberFormats(std::string_view text)
{
    NumberFormatFindings found;
    bool precisionDecided = false;
    std::size_t i = 0;
    for (; i + Block + 1 <= text.size(); i += Block)
        for (auto places = placesToCheck(text.data() + i); places != 0; places &= places - 1)
            checkAt(text, i + static_cast<std::size_t>(std::countr_zero(places)), precisionDecided, found);
    if (i == text.size())
        return found;
    // The last bytes, padded with NULs, which are neither dots nor digits.
    char tail[Block + 1] = {};
    std::memcpy(tail, text.data() + i, text.size() - i);
    for (auto places = placesToCheck(tail); places != 0; places &= places - 1)
        checkAt(text, i + static_cast<std::size_t>(std::countr_zero(places)), precisionDecided, found);
    return found;
}
