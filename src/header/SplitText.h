// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <string_view>
#include <vector>

// Splits text at every separator into pieces numbered from 0. An empty text gives no pieces; an
// empty separator gives the whole text.
std::vector<std::string> SplitText(std::string_view text, std::string_view separator);
