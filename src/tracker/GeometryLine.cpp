// SPDX-License-Identifier: MIT
#include "GeometryLine.h"

#include <charconv>
#include <cstdint>
#include <optional>

#include "TrackerText.h"

namespace {

struct NumberPrefix {
    std::size_t longest = 0;  // the length of the longest prefix that is a number, or 0
    bool ascii = true;        // its digits are ASCII ones
    std::uint64_t digits = 0; // its digits as one whole number, while they are few
    int count = 0, fraction = 0;
};

// Reads the digits of text from i on, within its first atMost bytes.
void readDigits(std::string_view text, std::size_t& i, std::size_t atMost, NumberPrefix& number, bool inFraction)
{
    const auto start = i;
    const int countBefore = number.count;
    while (i < atMost) {
        const auto c = static_cast<unsigned char>(text[i]);
        if (const unsigned digit = c - '0'; digit < 10) {
            number.digits = number.digits * 10 + digit;
            ++number.count;
            ++i;
            continue;
        }
        const auto length = c < 0x80 ? 0 : DigitLength(text.substr(i));
        if (length == 0 || i + length > atMost)
            break;
        number.ascii = false;
        i += length;
    }
    if (i > start)
        number.longest = i;
    if (inFraction)
        number.fraction += number.count - countBefore;
}

// The number at the start of text within its first atMost bytes.
NumberPrefix numberAt(std::string_view text, std::size_t atMost, bool plusAllowed)
{
    NumberPrefix result;
    std::size_t i = !text.empty() && (text[0] == '-' || (plusAllowed && text[0] == '+')) ? 1 : 0;
    readDigits(text, i, atMost, result, false);
    if (i < atMost && text[i] == '.') {
        ++i;
        readDigits(text, i, atMost, result, true);
    }
    return result;
}

// The number's value; numbers written with other than ASCII digits count as 0, as the Tracker's
// conversion has them. A short decimal is its digits as a whole number divided by a power of ten:
// both are exact doubles, so the one division rounds as a full conversion would. Most numbers of
// a part are short; the others take the full conversion.
double valueOf(std::string_view number, const NumberPrefix& read)
{
    static constexpr double PowersOfTen[] = {1e0, 1e1, 1e2,  1e3,  1e4,  1e5,  1e6,  1e7,
                                             1e8, 1e9, 1e10, 1e11, 1e12, 1e13, 1e14, 1e15};
    if (!read.ascii)
        return 0;
    if (read.count <= 15) {
        const auto value = static_cast<double>(read.digits) / PowersOfTen[read.fraction];
        return number[0] == '-' ? -value : value;
    }
    double value = 0;
    std::from_chars(number.data(), number.data() + number.size(), value);
    return value;
}

// The next space-delimited word of text from pos on; pos moves past it.
std::string_view nextWord(std::string_view text, std::size_t& pos)
{
    auto end = pos;
    while (end < text.size() && text[end] != ' ')
        ++end;
    const auto word = text.substr(pos, end - pos);
    pos = end;
    return word;
}

bool readColour(std::string_view word, GeometryLine& line)
{
    if (word.size() == 9 && word.substr(0, 3) == "0x2") {
        line.directColour = word.find_first_not_of("0123456789abcdefABCDEF", 3) == std::string_view::npos;
        return line.directColour;
    }
    line.colour = 0;
    bool ascii = true;
    for (std::size_t i = 0, digit = 0; i < word.size(); i += digit) {
        if ((digit = DigitLengthAt(word, i)) == 0)
            return false;
        ascii = ascii && digit == 1;
        if (ascii && line.colour >= 0)
            line.colour = line.colour > 99999999 ? -1 : line.colour * 10 + (word[i] - '0');
    }
    if (!ascii)
        line.colour = 0;
    return !word.empty();
}

// The type digit and the colour, each followed by a blank; pos moves to that blank.
bool readStart(std::string_view text, std::size_t& pos, GeometryLine& line)
{
    line.type = text[0] - '0';
    line.directColour = false;
    if (text.size() < 3 || text[1] != ' ')
        return false;
    pos = 2;
    line.colourText = nextWord(text, pos);
    return readColour(line.colourText, line) && pos < text.size();
}

// The common case, a number of ASCII digits, read in one pass: none when the word at pos is
// anything else, which the general reading then decides.
std::optional<bool> readPlainNumber(std::string_view text, std::size_t& pos, double& value)
{
    static constexpr double PowersOfTen[] = {1e0, 1e1, 1e2,  1e3,  1e4,  1e5,  1e6,  1e7,
                                             1e8, 1e9, 1e10, 1e11, 1e12, 1e13, 1e14, 1e15};
    const char* p = text.data() + pos;
    const char* const end = text.data() + text.size();
    const bool negative = p < end && *p == '-';
    p += negative ? 1 : 0;
    std::uint64_t digits = 0;
    int count = 0, fraction = 0;
    for (; p < end && static_cast<unsigned>(*p - '0') < 10; ++p, ++count)
        digits = digits * 10 + static_cast<unsigned>(*p - '0');
    if (p < end && *p == '.')
        for (++p; p < end && static_cast<unsigned>(*p - '0') < 10; ++p, ++count, ++fraction)
            digits = digits * 10 + static_cast<unsigned>(*p - '0');
    if (count > 15 || (p < end && *p != ' '))
        return std::nullopt;
    const auto word = text.substr(pos, static_cast<std::size_t>(p - (text.data() + pos)));
    pos += word.size();
    if (count == 0 || word.back() == '.')
        return false;
    value = static_cast<double>(digits); // exact, and most numbers of a part are whole
    if (fraction > 0)
        value /= PowersOfTen[fraction];
    value = negative ? -value : value;
    return true;
}

bool readNumber(std::string_view word, double& value)
{
    const auto number = numberAt(word, word.size(), false);
    if (number.longest != word.size() || word.empty())
        return false;
    value = valueOf(word, number);
    return true;
}

// Types 2 to 5: the colour, count numbers and nothing else.
bool readPointsLine(std::string_view text, std::size_t count, GeometryLine& line)
{
    std::size_t pos = 0;
    if (!readStart(text, pos, line))
        return false;
    for (std::size_t i = 0; i < count; ++i) {
        if (pos >= text.size() || text[pos] != ' ')
            return false;
        const auto plain = readPlainNumber(text, ++pos, line.numbers[i]);
        if (plain ? !*plain : !readNumber(nextWord(text, pos), line.numbers[i]))
            return false;
    }
    return pos == text.size() || text.substr(pos) == " ";
}

// Type 1: the colour, twelve numbers and a file name. The blank before the file name is optional,
// so the last number is the longest that leaves a name behind it: "... 0 1x.dat" places "x.dat"
// with 1 as the last entry.
bool readSubfileLine(std::string_view text, GeometryLine& line)
{
    std::size_t pos = 0;
    if (!readStart(text, pos, line))
        return false;
    for (std::size_t i = 0; i < 11; ++i) {
        if (pos >= text.size() || text[pos] != ' ')
            return false;
        const auto plain = readPlainNumber(text, ++pos, line.numbers[i]);
        if (plain ? !*plain : !readNumber(nextWord(text, pos), line.numbers[i]))
            return false;
    }
    if (pos >= text.size() || text[pos] != ' ')
        return false;
    const auto rest = text.substr(pos + 1);
    const auto number = numberAt(rest, rest.size() - std::min<std::size_t>(rest.size(), 1), false);
    if (number.longest == 0)
        return false;
    line.numbers[11] = valueOf(rest.substr(0, number.longest), number);
    auto file = rest.substr(number.longest);
    while (!file.empty() && file.front() == ' ')
        file.remove_prefix(1);
    while (!file.empty() && file.back() == ' ')
        file.remove_suffix(1);
    line.file = file;
    return !file.empty();
}

} // namespace

bool IsTrackerNumber(std::string_view text, bool plusAllowed)
{
    return !text.empty() && numberAt(text, text.size(), plusAllowed).longest == text.size();
}

bool ReadGeometryLine(std::string_view text, GeometryLine& line)
{
    switch (text.empty() ? 0 : text[0]) {
    case '1': return readSubfileLine(text, line);
    case '2': return readPointsLine(text, 6, line);
    case '3': return readPointsLine(text, 9, line);
    case '4':
    case '5': return readPointsLine(text, 12, line);
    default: return false;
    }
}
