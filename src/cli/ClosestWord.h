// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <string_view>
#include <vector>

// The word of words that takes the fewest single-character edits to turn into typed; empty when
// even the closest needs more edits than it keeps characters, which would be no hint.
std::string ClosestWord(std::string_view typed, const std::vector<std::string>& words);
