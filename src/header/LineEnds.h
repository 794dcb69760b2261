#pragma once

#include <string>
#include <string_view>

// True when the first line of text, as the line reader returns it, holds an LF: the sign of a
// file whose lines end with LF alone.
bool IsUnixLineEnd(std::string_view text);

// Turns every LF that does not follow a CR into CR LF; existing CR LF pairs stay as they are.
std::string LfToCrLf(std::string_view text);

// Replaces occurrences of search by replacement, left to right and without overlap, starting
// at the 1-based position start and replacing at most maxCount of them. With ignoreCase the
// search compares ASCII letters without regard to case; the text outside the replaced
// occurrences keeps its letters as they were.
std::string ReplaceText(std::string_view text, std::string_view search, std::string_view replacement,
                        std::size_t start, std::size_t maxCount, bool ignoreCase);

// Every occurrence, exact case: the form the body fix-ups use.
std::string ReplaceAll(std::string_view text, std::string_view search, std::string_view replacement);
