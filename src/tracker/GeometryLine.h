// SPDX-License-Identifier: MIT
#pragma once

#include <array>
#include <string_view>

// A line of type 1 to 5 as the Parts Tracker reads it: the type digit, the colour and the
// numbers, each after one or more blanks; a type 1 line ends in its file name.
struct GeometryLine {
    int type = 0;
    bool directColour = false; // "0x2RRGGBB", never one of the colour codes
    long colour = 0;           // the code as a number ("016" is 16); -1 when too long to be one
    std::string_view colourText;
    std::array<double, 12> numbers{};
    std::string_view file; // type 1: the file it places
};

// Reads text, a line trimmed and with its runs of blanks collapsed to one space, which starts
// with a digit 1 to 5. False when it has not the shape of its type.
bool ReadGeometryLine(std::string_view text, GeometryLine& line);

// True when text is a number: an optional "-" (or "+" when plusAllowed), then digits, or
// optional digits, "." and digits.
bool IsTrackerNumber(std::string_view text, bool plusAllowed = false);
