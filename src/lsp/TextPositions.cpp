// SPDX-License-Identifier: MIT
#include "TextPositions.h"

#include <algorithm>
#include <cstring>

namespace {

// The bytes of the UTF-8 character starting with lead; 1 for a byte that starts none, which then
// counts as a character of its own.
std::size_t sequenceLength(unsigned char lead)
{
    if (lead >= 0xF0 && lead < 0xF8)
        return 4;
    if (lead >= 0xE0)
        return lead < 0xF0 ? 3 : 1;
    if (lead >= 0xC0)
        return 2;
    return 1;
}

// The UTF-16 code units of the character of that many UTF-8 bytes.
std::size_t utf16Units(std::size_t bytes) { return bytes == 4 ? 2 : 1; }

// The length of the character at the offset, no further than end.
std::size_t characterAt(std::string_view text, std::size_t offset, std::size_t end)
{
    const auto length = sequenceLength(static_cast<unsigned char>(text[offset]));
    if (offset + length > end)
        return 1;
    for (std::size_t k = 1; k < length; ++k)
        if ((static_cast<unsigned char>(text[offset + k]) & 0xC0) != 0x80)
            return 1;
    return length;
}

} // namespace

LineIndex::LineIndex(std::string_view text)
{
    starts_.push_back(0);
    const char* data = text.data();
    const char* end = data + text.size();
    for (const char* at = data; at < end;) {
        // The next CR or LF, whichever comes first.
        const auto* lineFeed = static_cast<const char*>(std::memchr(at, '\n', static_cast<std::size_t>(end - at)));
        const auto* returnChar =
            static_cast<const char*>(std::memchr(at, '\r', static_cast<std::size_t>((lineFeed ? lineFeed : end) - at)));
        const char* brk = returnChar ? returnChar : lineFeed;
        if (brk == nullptr)
            break;
        at = brk + 1;
        if (*brk == '\r' && at < end && *at == '\n')
            ++at;
        starts_.push_back(static_cast<std::size_t>(at - data));
    }
}

std::size_t LineIndex::contentEnd(std::string_view text, std::size_t line) const
{
    auto end = line + 1 < starts_.size() ? starts_[line + 1] : text.size();
    if (end > starts_[line] && text[end - 1] == '\n')
        --end;
    if (end > starts_[line] && text[end - 1] == '\r')
        --end;
    return end;
}

std::size_t LineIndex::offsetOf(std::string_view text, TextPosition position, PositionEncoding encoding) const
{
    if (position.line >= starts_.size())
        return text.size();
    const auto start = starts_[position.line];
    const auto end = contentEnd(text, position.line);
    if (encoding == PositionEncoding::Utf8)
        return std::min(start + position.character, end);
    auto offset = start;
    for (std::size_t units = 0; offset < end;) {
        const auto length = characterAt(text, offset, end);
        units += utf16Units(length);
        if (units > position.character)
            break;
        offset += length;
    }
    return offset;
}

TextPosition LineIndex::positionOf(std::string_view text, std::size_t offset, PositionEncoding encoding) const
{
    offset = std::min(offset, text.size());
    const auto line =
        static_cast<std::size_t>(std::upper_bound(starts_.begin(), starts_.end(), offset) - starts_.begin()) - 1;
    const auto start = starts_[line];
    const auto end = std::min(offset, contentEnd(text, line));
    if (encoding == PositionEncoding::Utf8)
        return {line, end - start};
    std::size_t units = 0;
    for (auto at = start; at < end;) {
        const auto length = characterAt(text, at, end);
        units += utf16Units(length);
        at += length;
    }
    return {line, units};
}
