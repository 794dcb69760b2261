// SPDX-License-Identifier: MIT
#include "ColourCodes.h"

#include <algorithm>
#include <charconv>
#include <string>

#include "MetaLine.h"
#include "Text.h"
#include "TrackerText.h"

ColourCodes::ColourCodes(std::vector<long> codes) : codes_(std::move(codes))
{
    std::sort(codes_.begin(), codes_.end());
    codes_.erase(std::unique(codes_.begin(), codes_.end()), codes_.end());
}

bool ColourCodes::contains(long code) const { return std::binary_search(codes_.begin(), codes_.end(), code); }

namespace {
constexpr long MaxRange = 100000; // a range that long is a typing error, not a list
} // namespace

std::optional<ColourCodes> ReadColourRanges(std::string_view text)
{
    std::vector<long> codes;
    const char* p = text.data();
    const char* const end = p + text.size();
    const auto skipSeparators = [&] {
        while (p < end && (*p == ',' || IsTrimmed(*p)))
            ++p;
    };
    for (skipSeparators(); p < end; skipSeparators()) {
        long first = 0, last = 0;
        auto read = std::from_chars(p, end, first);
        if (read.ec != std::errc())
            return std::nullopt;
        last = first;
        if (read.ptr < end && *read.ptr == '-') {
            read = std::from_chars(read.ptr + 1, end, last);
            if (read.ec != std::errc() || last < first || last - first > MaxRange)
                return std::nullopt;
        }
        for (long code = first; code <= last; ++code)
            codes.push_back(code);
        p = read.ptr;
        if (p < end && *p != ',' && !IsTrimmed(*p))
            return std::nullopt;
    }
    if (codes.empty())
        return std::nullopt;
    return ColourCodes(std::move(codes));
}

std::optional<ColourCodes> ReadLDConfig(std::string_view text)
{
    const auto utf8 = IsValidUtf8(text) ? std::string(text) : Latin1ToUtf8(text);
    std::vector<long> codes;
    TrackerLines lines(utf8);
    std::string buffer;
    for (TrackerLine line; lines.next(line);) {
        const auto collapsed = CollapseBlanks(line.text, buffer);
        if (collapsed.starts_with("0 !COLOUR "))
            if (const auto code = ColourDefinitionCode(collapsed))
                codes.push_back(*code);
    }
    if (codes.empty())
        return std::nullopt;
    return ColourCodes(std::move(codes));
}
