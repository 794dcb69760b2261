// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <string_view>

// What a header meta line means in the library's rules, in a sentence or two; empty for a line
// that is none of them.
std::string MetaLineHelp(std::string_view line);
