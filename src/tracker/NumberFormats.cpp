#include "NumberFormats.h"

#include <array>

namespace {

bool isDigit(char c) { return c >= '0' && c <= '9'; }

// Words end at a blank; fractions start at a dot.
enum ByteKind : unsigned char { Other, Blank, Dot };
constexpr auto ByteKinds = [] {
    std::array<ByteKind, 256> kinds{};
    kinds[' '] = kinds['\t'] = kinds[0xA0] = Blank;
    kinds['.'] = Dot;
    return kinds;
}();
ByteKind kindOf(char c) { return ByteKinds[static_cast<unsigned char>(c)]; }

std::size_t digitsFrom(std::string_view text, std::size_t i)
{
    auto end = i;
    while (end < text.size() && isDigit(text[end]))
        ++end;
    return end - i;
}

// "-?0\d+(\.\d+)?", the whole word.
bool hasLeadingZero(std::string_view word)
{
    std::size_t i = !word.empty() && word[0] == '-' ? 1 : 0;
    if (i + 1 >= word.size() || word[i] != '0' || !isDigit(word[i + 1]))
        return false;
    i += 1 + digitsFrom(word, i + 1);
    if (i < word.size() && word[i] == '.' && digitsFrom(word, i + 1) > 0)
        i += 1 + digitsFrom(word, i + 1);
    return i == word.size();
}

} // namespace

NumberFormatFindings CheckNumberFormats(std::string_view text)
{
    NumberFormatFindings found;
    bool precisionDecided = false;
    for (std::size_t start = 0; start < text.size();) {
        auto end = start;
        auto firstDot = std::string_view::npos;
        for (ByteKind kind{}; end < text.size() && (kind = kindOf(text[end])) != Blank; ++end)
            if (kind == Dot && firstDot == std::string_view::npos)
                firstDot = end;
        const auto word = text.substr(start, end - start);
        for (auto dot = firstDot; dot < end; ++dot) {
            if (text[dot] != '.')
                continue;
            const auto fraction = digitsFrom(text, dot + 1);
            if (!precisionDecided && fraction >= 5) {
                precisionDecided = true;
                found.tooPrecise = fraction >= 6 ? word : std::string_view();
            }
            if (found.trailingZero.empty() && fraction > 0 && dot + 1 + fraction == end && text[end - 1] == '0')
                found.trailingZero = word;
        }
        if (found.leadingZero.empty() && (word[0] == '0' || word[0] == '-') && end < text.size() &&
            hasLeadingZero(word))
            found.leadingZero = word;
        start = end;
        while (start < text.size() && kindOf(text[start]) == Blank)
            ++start;
    }
    return found;
}
