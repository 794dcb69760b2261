// SPDX-License-Identifier: MIT
#pragma once

#include <string>

// text with end in place of each of its CR LFs: the same part with other line ends.
std::string WithLineEnds(const std::string& text, const std::string& end);
