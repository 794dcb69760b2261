// SPDX-License-Identifier: MIT
#include "Dates.h"

#include <cstdio>

namespace {

// Reads between minDigits and maxDigits decimal digits from the front of text.
std::optional<int> takeNumber(std::string_view& text, std::size_t minDigits, std::size_t maxDigits)
{
    std::size_t digits = 0;
    int value = 0;
    while (digits < text.size() && digits < maxDigits && text[digits] >= '0' && text[digits] <= '9') {
        value = value * 10 + (text[digits] - '0');
        ++digits;
    }
    if (digits < minDigits)
        return std::nullopt;
    text.remove_prefix(digits);
    return value;
}

bool takeDash(std::string_view& text)
{
    if (text.empty() || text.front() != '-')
        return false;
    text.remove_prefix(1);
    return true;
}

bool isLeapYear(int year) { return (year % 4 == 0 && year % 100 != 0) || year % 400 == 0; }

int daysInMonth(int year, int month)
{
    static constexpr int days[] = {31, 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
    return (month == 2 && isLeapYear(year)) ? 29 : days[month - 1];
}

} // namespace

std::optional<std::string> DateOfWord(std::string_view word)
{
    const auto year = takeNumber(word, 4, 4);
    if (!year || !takeDash(word))
        return std::nullopt;
    const auto month = takeNumber(word, 1, 2);
    if (!month || !takeDash(word))
        return std::nullopt;
    const auto day = takeNumber(word, 1, 2);
    if (!day || !word.empty())
        return std::nullopt;
    if (*year < 1 || *month < 1 || *month > 12 || *day < 1 || *day > daysInMonth(*year, *month))
        return std::nullopt;
    return FormatDate(*year, *month, *day);
}

std::string FormatDate(int year, int month, int day)
{
    char text[16];
    std::snprintf(text, sizeof text, "%04d-%02d-%02d", year, month, day);
    return text;
}
