// SPDX-License-Identifier: MIT
#pragma once

#include <optional>
#include <string>
#include <string_view>

// A word is a date exactly when it reads year-month-day with a four-digit year, a one- or
// two-digit month and day, separated by "-", naming a real day of the Gregorian calendar from
// year 1 on. The same on every machine, whatever its locale. Returns the date as YYYY-MM-DD.
std::optional<std::string> DateOfWord(std::string_view word);

// YYYY-MM-DD, zero-padded.
std::string FormatDate(int year, int month, int day);
