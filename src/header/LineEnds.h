// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <string_view>

// True when the first line of text, as the line reader returns it, holds an LF: the sign of a
// file whose lines end with LF alone.
bool IsUnixLineEnd(std::string_view text);

// Turns every LF that does not follow a CR into CR LF, where the text lies: it grows into the
// string's spare capacity (or, without enough of it, into one new buffer of the final size).
// Existing CR LF pairs stay as they are.
void LfToCrLf(std::string& text);

// Moves the text from position from on gap bytes further back and turns every CR there that no
// LF follows into CR LF, so that every line of it ends the same way; the bytes before from stay.
void WidenLoneCrs(std::string& text, std::size_t from, std::size_t gap);

// Replaces every occurrence of search, exact case, left to right and without overlap: the form
// the body fix-ups use.
std::string ReplaceAll(std::string_view text, std::string_view search, std::string_view replacement);
