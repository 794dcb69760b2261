// SPDX-License-Identifier: MIT
#include "Text.h"

#include <algorithm>
#include <cstdint>
#include <cstring>

namespace {

char lowerAscii(char c) { return (c >= 'A' && c <= 'Z') ? static_cast<char>(c - 'A' + 'a') : c; }
char upperAscii(char c) { return (c >= 'a' && c <= 'z') ? static_cast<char>(c - 'a' + 'A') : c; }

bool equalIgnoreCaseAt(std::string_view text, std::size_t pos, std::string_view needle)
{
    for (std::size_t i = 0; i < needle.size(); ++i)
        if (lowerAscii(text[pos + i]) != lowerAscii(needle[i]))
            return false;
    return true;
}

// Length of the UTF-8 sequence starting at s[i], or 0 when it is not a valid one.
std::size_t utf8SequenceLength(std::string_view s, std::size_t i)
{
    const auto lead = static_cast<unsigned char>(s[i]);
    if (lead < 0x80)
        return 1;
    std::size_t length = 0;
    unsigned min = 0;
    unsigned codePoint = 0;
    if ((lead & 0xE0) == 0xC0) {
        length = 2;
        min = 0x80;
        codePoint = lead & 0x1F;
    } else if ((lead & 0xF0) == 0xE0) {
        length = 3;
        min = 0x800;
        codePoint = lead & 0x0F;
    } else if ((lead & 0xF8) == 0xF0) {
        length = 4;
        min = 0x10000;
        codePoint = lead & 0x07;
    } else
        return 0;
    if (i + length > s.size())
        return 0;
    for (std::size_t k = 1; k < length; ++k) {
        const auto next = static_cast<unsigned char>(s[i + k]);
        if ((next & 0xC0) != 0x80)
            return 0;
        codePoint = (codePoint << 6) | (next & 0x3F);
    }
    const bool surrogate = codePoint >= 0xD800 && codePoint <= 0xDFFF;
    if (codePoint < min || codePoint > 0x10FFFF || surrogate)
        return 0;
    return length;
}

} // namespace

std::string_view TrimTrailingBlanks(std::string_view text) { return text.substr(0, text.find_last_not_of(' ') + 1); }

std::string_view TrimBlanks(std::string_view text)
{
    const auto first = text.find_first_not_of(' ');
    if (first == std::string_view::npos)
        return {};
    return TrimTrailingBlanks(text.substr(first));
}

std::string ToLowerAscii(std::string_view text)
{
    std::string result(text);
    std::transform(result.begin(), result.end(), result.begin(), lowerAscii);
    return result;
}

std::string ToUpperAscii(std::string_view text)
{
    std::string result(text);
    std::transform(result.begin(), result.end(), result.begin(), upperAscii);
    return result;
}

bool ContainsIgnoreCase(std::string_view text, std::string_view needle)
{
    if (needle.empty())
        return true;
    const char first = needle.front();
    const bool firstHasCase = lowerAscii(first) != upperAscii(first);
    for (std::size_t pos = 0; pos + needle.size() <= text.size(); ++pos) {
        // A first byte without case ("0 WRITE") lets memchr skip to the candidates, so a body of
        // megabytes is not folded byte by byte.
        if (!firstHasCase) {
            const auto* found =
                static_cast<const char*>(std::memchr(text.data() + pos, first, text.size() - needle.size() + 1 - pos));
            if (found == nullptr)
                return false;
            pos = static_cast<std::size_t>(found - text.data());
        }
        if (equalIgnoreCaseAt(text, pos, needle))
            return true;
    }
    return false;
}

bool StartsWithIgnoreCase(std::string_view text, std::string_view prefix)
{
    return text.size() >= prefix.size() && equalIgnoreCaseAt(text, 0, prefix);
}

namespace {

// Part files are mostly ASCII: 64 bytes are tested at once, as eight words.
constexpr std::size_t AsciiBlock = 64;

bool asciiBlockAt(std::string_view bytes, std::size_t i)
{
    std::uint64_t any = 0;
    for (std::size_t k = 0; k < AsciiBlock; k += sizeof any) {
        std::uint64_t word = 0;
        std::memcpy(&word, bytes.data() + i + k, sizeof word);
        any |= word;
    }
    return (any & 0x8080808080808080ULL) == 0;
}

} // namespace

std::size_t CheckUtf8(std::string_view bytes, std::size_t from, std::size_t until)
{
    until = std::min(until, bytes.size());
    auto i = from;
    while (i < until) {
        if (i + AsciiBlock <= bytes.size() && asciiBlockAt(bytes, i)) {
            i += AsciiBlock;
            continue;
        }
        // A block with other bytes, or the last bytes: one character at a time.
        const auto blockEnd = std::min(i + AsciiBlock, bytes.size());
        while (i < blockEnd) {
            const auto length = utf8SequenceLength(bytes, i);
            if (length == 0)
                return std::string_view::npos;
            i += length;
        }
    }
    return i;
}

bool IsValidUtf8(std::string_view bytes) { return CheckUtf8(bytes, 0, bytes.size()) != std::string_view::npos; }

TextEncoding EncodingOf(std::string_view bytes)
{
    return IsValidUtf8(bytes) ? TextEncoding::Utf8 : TextEncoding::Latin1;
}

std::size_t CharacterCount(std::string_view text, TextEncoding encoding)
{
    if (encoding == TextEncoding::Latin1 || !IsValidUtf8(text))
        return text.size();
    return static_cast<std::size_t>(
        std::count_if(text.begin(), text.end(), [](char c) { return (static_cast<unsigned char>(c) & 0xC0) != 0x80; }));
}

std::string Latin1ToUtf8(std::string_view bytes)
{
    std::string result;
    result.reserve(bytes.size());
    for (const char c : bytes) {
        const auto code = static_cast<unsigned char>(c);
        if (code < 0x80) {
            result += c;
        } else {
            result += static_cast<char>(0xC0 | (code >> 6));
            result += static_cast<char>(0x80 | (code & 0x3F));
        }
    }
    return result;
}

std::optional<std::string> Utf8ToFileText(std::string_view utf8, TextEncoding encoding)
{
    if (encoding == TextEncoding::Utf8)
        return std::string(utf8);
    std::string result;
    result.reserve(utf8.size());
    for (std::size_t at = 0; at < utf8.size(); ++at) {
        const auto lead = static_cast<unsigned char>(utf8[at]);
        if (lead < 0x80) {
            result += static_cast<char>(lead);
            continue;
        }
        // U+0080 to U+00FF take two bytes with a lead of C2 or C3; every other character has none.
        if ((lead != 0xC2 && lead != 0xC3) || at + 1 >= utf8.size())
            return std::nullopt;
        result += static_cast<char>(((lead & 0x03) << 6) | (static_cast<unsigned char>(utf8[++at]) & 0x3F));
    }
    return result;
}
