#include "LineEnds.h"

#include <cstring>
#include <limits>

#include "LineReader.h"
#include "Text.h"

bool IsUnixLineEnd(std::string_view text)
{
    LineReader reader(text);
    return !reader.atEnd() && reader.nextLine().find('\n') != std::string_view::npos;
}

std::string LfToCrLf(std::string_view text)
{
    std::string result;
    result.reserve(text.size() + text.size() / 16 + 2);
    std::size_t position = 0;
    while (position < text.size()) {
        const char* start = text.data() + position;
        const auto* lf = static_cast<const char*>(std::memchr(start, '\n', text.size() - position));
        if (lf == nullptr) {
            result.append(start, text.size() - position);
            break;
        }
        const auto lfPosition = static_cast<std::size_t>(lf - text.data());
        result.append(start, lfPosition - position);
        if (lfPosition == 0 || text[lfPosition - 1] != '\r')
            result += '\r';
        result += '\n';
        position = lfPosition + 1;
    }
    return result;
}

std::string ReplaceText(std::string_view text, std::string_view search, std::string_view replacement,
                        std::size_t start, std::size_t maxCount, bool ignoreCase)
{
    if (search.empty() || start == 0)
        return std::string(text);
    std::string result;
    result.reserve(text.size());
    std::size_t copiedUpTo = 0;
    std::size_t searchFrom = start - 1;
    for (std::size_t replaced = 0; replaced < maxCount; ++replaced) {
        const auto found = ignoreCase ? FindIgnoreCase(text, search, searchFrom) : text.find(search, searchFrom);
        if (found == std::string_view::npos)
            break;
        result.append(text, copiedUpTo, found - copiedUpTo);
        result.append(replacement);
        copiedUpTo = searchFrom = found + search.size();
    }
    result.append(text, copiedUpTo);
    return result;
}

std::string ReplaceAll(std::string_view text, std::string_view search, std::string_view replacement)
{
    return ReplaceText(text, search, replacement, 1, std::numeric_limits<std::size_t>::max(), false);
}
