// SPDX-License-Identifier: MIT
#pragma once

#include <optional>
#include <string_view>
#include <vector>

// The colour codes a part may use: those an LDConfig.ldr defines.
class ColourCodes {
public:
    explicit ColourCodes(std::vector<long> codes);
    bool contains(long code) const;
    std::size_t size() const { return codes_.size(); }

private:
    std::vector<long> codes_; // sorted
};

// The codes of a list written as "0-47,52,54,57,60-87": codes and ranges separated by commas,
// blanks and line breaks. None when the text holds anything else or no code at all.
std::optional<ColourCodes> ReadColourRanges(std::string_view text);

// The codes of every "0 !COLOUR" line of an LDConfig.ldr that has the shape the Parts Tracker
// accepts. None when there is not one such line.
std::optional<ColourCodes> ReadLDConfig(std::string_view text);
