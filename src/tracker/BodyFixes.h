// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <vector>

// Repairs of the Parts Tracker's findings on the body's geometry lines (and the lines inside
// "0 !:"). Only the characters of the numbers or colours they name change, never the blanks
// between the words, and only on lines that have the finding.

// What a repair did to a text: how many findings it cleared, and why it left each one it left.
struct FixNote {
    int fixed = 0;
    std::vector<std::string> left;
};

enum class NumberFix { TrailingZeros, LeadingZeros, DecimalPrecision };

// Rewrites the numbers of each body line that has the finding. Rounding keeps a line's numbers
// when it would give the line a geometry finding it did not have. firstLine is the number of the
// body's first line in the file, for the notes.
FixNote FixNumbers(std::string& body, NumberFix fix, int firstLine);

// Lines and optional lines (types 2 and 5) take the edge colour 24.
FixNote FixLineColours(std::string& body, int firstLine);
