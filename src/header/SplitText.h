#pragma once

#include <string>
#include <string_view>
#include <vector>

enum class CompareMode { Exact = 0, IgnoreCase = 1 };

// Splits text at separator into pieces numbered from 0. An empty text or a limit of 0 gives no
// pieces; an empty separator gives the whole text. A limit of 1 or more allows at most limit
// pieces; -1 means no limit.
std::vector<std::string> SplitText(std::string_view text, std::string_view separator, int limit = -1,
                                   CompareMode mode = CompareMode::Exact);
