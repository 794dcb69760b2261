// SPDX-License-Identifier: MIT
#include "NumberRewrite.h"

namespace {

constexpr std::size_t KeptDecimals = 5;

// The number's parts: "-", the digits before the point, the digits after it.
struct NumberParts {
    bool negative = false;
    std::string whole, fraction;

    explicit NumberParts(std::string_view number)
    {
        negative = !number.empty() && number[0] == '-';
        number.remove_prefix(negative ? 1 : 0);
        const auto point = number.find('.');
        whole = number.substr(0, point);
        if (point != std::string_view::npos)
            fraction = number.substr(point + 1);
    }

    bool zero() const
    {
        return whole.find_first_not_of('0') == std::string::npos &&
               fraction.find_first_not_of('0') == std::string::npos;
    }

    // A zero is written without its sign, and a number left without digits as "0".
    std::string text() const
    {
        std::string result = negative && !zero() ? "-" : "";
        result += whole;
        if (!fraction.empty())
            result.append(1, '.').append(fraction);
        else if (whole.empty())
            result += "0";
        return result;
    }
};

// Adds one to the last digit of digits; true when it carries past the first one.
bool incremented(std::string& digits)
{
    for (auto i = digits.size(); i-- > 0;) {
        if (digits[i] != '9') {
            ++digits[i];
            return false;
        }
        digits[i] = '0';
    }
    return true;
}

} // namespace

std::string WithoutTrailingZeros(std::string_view number)
{
    if (number.find('.') == std::string_view::npos)
        return std::string(number);
    NumberParts parts(number);
    parts.fraction.erase(parts.fraction.find_last_not_of('0') + 1);
    return parts.text();
}

std::string WithoutLeadingZeros(std::string_view number)
{
    NumberParts parts(number);
    const auto firstSignificant = parts.whole.find_first_not_of('0');
    if (firstSignificant == 0 || parts.whole.size() < 2)
        return std::string(number);
    parts.whole.erase(0, firstSignificant == std::string::npos ? parts.whole.size() - 1 : firstSignificant);
    std::string result = parts.negative ? "-" : "";
    result += parts.whole;
    if (number.find('.') != std::string_view::npos)
        result.append(1, '.').append(parts.fraction);
    return result;
}

std::string RoundedToFiveDecimals(std::string_view number)
{
    NumberParts parts(number);
    if (parts.fraction.size() <= KeptDecimals)
        return std::string(number);
    const bool roundUp = parts.fraction[KeptDecimals] >= '5';
    parts.fraction.resize(KeptDecimals);
    if (roundUp && incremented(parts.fraction) && incremented(parts.whole))
        parts.whole.insert(0, 1, '1');
    parts.fraction.erase(parts.fraction.find_last_not_of('0') + 1);
    return parts.text();
}
