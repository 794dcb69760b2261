#pragma once

#include <string>
#include <string_view>

// True when the first line of text, as the line reader returns it, holds an LF: the sign of a
// file whose lines end with LF alone.
bool IsUnixLineEnd(std::string_view text);

// Turns every LF that does not follow a CR into CR LF; existing CR LF pairs stay as they are.
std::string LfToCrLf(std::string_view text);

// Replaces every occurrence of search, exact case, left to right and without overlap: the form
// the body fix-ups use.
std::string ReplaceAll(std::string_view text, std::string_view search, std::string_view replacement);
