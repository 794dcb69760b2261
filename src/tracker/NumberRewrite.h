// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <string_view>

// Rewrites of one number of a geometry line, each a number as the Parts Tracker reads it (an
// optional "-", then digits, or optional digits, "." and digits; ASCII digits only). Each gives
// the same number written otherwise, or the text unchanged when there is nothing to rewrite.

// The zeros at the end of the fraction go, and the point with them when nothing is left after it:
// "1.500" is "1.5", "2.0" is "2", "-0.0" is "0".
std::string WithoutTrailingZeros(std::string_view number);

// The zeros before the first significant digit go, one kept before the point: "007" is "7",
// "-00.5" is "-0.5".
std::string WithoutLeadingZeros(std::string_view number);

// A number of more than five decimals, rounded to five (half away from zero) and then without its
// trailing zeros: "1.0000005" is "1", "0.999999" is "1", "0.1234567" is "0.12346".
std::string RoundedToFiveDecimals(std::string_view number);
