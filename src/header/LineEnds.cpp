#include "LineEnds.h"

#include <cstring>

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

std::string ReplaceAll(std::string_view text, std::string_view search, std::string_view replacement)
{
    if (search.empty())
        return std::string(text);
    std::string result;
    result.reserve(text.size());
    std::size_t copiedUpTo = 0;
    for (auto found = text.find(search); found != std::string_view::npos; found = text.find(search, copiedUpTo)) {
        result.append(text, copiedUpTo, found - copiedUpTo);
        result.append(replacement);
        copiedUpTo = found + search.size();
    }
    result.append(text, copiedUpTo);
    return result;
}
