// SPDX-License-Identifier: MIT
#include "LineEndText.h"

#include <algorithm>

std::string WithLineEnds(const std::string& text, const std::string& end)
{
    std::string result;
    for (std::size_t at = 0; at < text.size();) {
        const auto crLf = std::min(text.find("\r\n", at), text.size());
        result += text.substr(at, crLf - at);
        if (crLf < text.size())
            result += end;
        at = crLf + 2;
    }
    return result;
}
