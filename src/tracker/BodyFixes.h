// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

// Repairs of the Parts Tracker's findings on the body's geometry lines (and the lines inside
// "0 !:"). Only the characters of the numbers or colours they name change, never the blanks
// between the words, and only on lines that have the finding.

// What a repair did to a text: how many findings it cleared, and why it left each one it left.
struct FixNote {
    int fixed = 0;
    int numbers = 0; // the numbers or colours rewritten
    std::vector<std::string> left;
};

enum class NumberFix { TrailingZeros, LeadingZeros, DecimalPrecision };

// Rewrites the numbers of each body line that has the finding. Rounding keeps a line's numbers
// when it would give the line a geometry finding it did not have. firstLine is the number of the
// body's first line in the file, for the notes.
FixNote FixNumbers(std::string& body, NumberFix fix, int firstLine);

// Lines and optional lines (types 2 and 5) take the edge colour 24.
FixNote FixLineColours(std::string& body, int firstLine);

// The same for one line, number being its line in the file for the note: the line rewritten, or
// nothing when it stays as it is.
std::optional<std::string> FixLineNumbers(std::string_view line, NumberFix fix, std::size_t number, FixNote& note);
std::optional<std::string> FixLineColour(std::string_view line, FixNote& note);
