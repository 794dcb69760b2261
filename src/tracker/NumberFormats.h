// SPDX-License-Identifier: MIT
#pragma once

#include <string_view>

// The Parts Tracker's rules on how numbers are written, run over a line's text (trimmed, blanks
// collapsed) as bytes: digits are ASCII ones, and a blank is a space, a TAB or the byte 0xA0.
// Each names the offending word, or is empty when the rule passes.
struct NumberFormatFindings {
    // The first fraction of five digits or more has six or more: "0.123456". Only that first
    // long fraction counts: "0.12345 ... 1.123456" passes.
    std::string_view tooPrecise;
    // A fraction that ends in 0 before a blank or the end: "1.0", "1.50", "0.000".
    std::string_view trailingZero;
    // A word "0" and more digits, with an optional fraction, followed by a blank: "01", "-00.5",
    // a colour "016". The text's last word is never one, since no blank follows it.
    std::string_view leadingZero;
};

// The three rules over text.
NumberFormatFindings CheckNumberFormats(std::string_view text);
