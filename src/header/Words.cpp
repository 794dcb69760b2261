// SPDX-License-Identifier: MIT
#include "Words.h"

#include <algorithm>

#include "Text.h"

Words::Words(std::string_view line) : text_(line)
{
    if (line.empty())
        return;
    // Blanks at the end make no words: a field or list entry ending in blanks would be written
    // back with them and read back without them, so that a file changed with every save.
    text_ = TrimTrailingBlanks(text_);
    count_ = 1 + static_cast<std::size_t>(std::count(text_.begin(), text_.end(), ' '));
}

std::size_t Words::startOf(std::size_t position) const
{
    if (position < cursorPosition_) {
        cursorPosition_ = 1;
        cursorOffset_ = 0;
    }
    while (cursorPosition_ < position) {
        cursorOffset_ = text_.find(' ', cursorOffset_) + 1;
        ++cursorPosition_;
    }
    return cursorOffset_;
}

std::string_view Words::word(std::size_t position) const
{
    const auto start = startOf(position);
    const auto end = text_.find(' ', start);
    return text_.substr(start, end == std::string_view::npos ? std::string_view::npos : end - start);
}

std::string_view Words::joinedFrom(std::size_t k) const
{
    if (k > count_)
        return {};
    const auto rest = text_.substr(startOf(k));
    const auto firstText = rest.find_first_not_of(' '); // the line's blanks at the end are gone already
    return firstText == std::string_view::npos ? std::string_view() : rest.substr(firstText);
}
