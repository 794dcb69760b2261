// SPDX-License-Identifier: MIT
#include "SplitText.h"

std::vector<std::string> SplitText(std::string_view text, std::string_view separator)
{
    std::vector<std::string> pieces;
    if (text.empty())
        return pieces;
    if (separator.empty())
        return {std::string(text)};
    std::size_t pieceStart = 0;
    for (auto found = text.find(separator); found != std::string_view::npos; found = text.find(separator, pieceStart)) {
        pieces.emplace_back(text.substr(pieceStart, found - pieceStart));
        pieceStart = found + separator.size();
    }
    pieces.emplace_back(text.substr(pieceStart));
    return pieces;
}
