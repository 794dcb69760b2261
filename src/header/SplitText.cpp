#include "SplitText.h"

#include "Text.h"

std::vector<std::string> SplitText(std::string_view text, std::string_view separator, int limit, CompareMode mode)
{
    std::vector<std::string> pieces;
    if (text.empty() || limit == 0)
        return pieces;
    if (separator.empty())
        return {std::string(text)};
    std::size_t pieceStart = 0;
    for (;;) {
        const bool limitReached = limit > 0 && pieces.size() + 1 >= static_cast<std::size_t>(limit);
        const auto found = limitReached ? std::string_view::npos
                           : mode == CompareMode::IgnoreCase ? FindIgnoreCase(text, separator, pieceStart)
                                                             : text.find(separator, pieceStart);
        if (found == std::string_view::npos)
            break;
        pieces.emplace_back(text.substr(pieceStart, found - pieceStart));
        pieceStart = found + separator.size();
    }
    pieces.emplace_back(text.substr(pieceStart));
    return pieces;
}
