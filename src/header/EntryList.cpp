// SPDX-License-Identifier: MIT
#include "EntryList.h"

EntryList::EntryList(std::initializer_list<std::string_view> entries)
{
    for (const auto entry : entries)
        push_back(entry);
}

void EntryList::pushPieces(std::initializer_list<std::string_view> pieces)
{
    for (const auto piece : pieces)
        text_ += piece;
    ends_.push_back(text_.size());
}

void EntryList::replace(std::size_t row, std::string_view entry)
{
    const auto start = startOf(row);
    const auto oldSize = ends_[row] - start;
    text_.replace(start, oldSize, entry);
    shiftEndsFrom(row, static_cast<std::ptrdiff_t>(entry.size()) - static_cast<std::ptrdiff_t>(oldSize));
}

void EntryList::erase(std::size_t row)
{
    const auto start = startOf(row);
    const auto oldSize = ends_[row] - start;
    text_.erase(start, oldSize);
    ends_.erase(ends_.begin() + static_cast<std::ptrdiff_t>(row));
    shiftEndsFrom(row, -static_cast<std::ptrdiff_t>(oldSize));
}

void EntryList::clear()
{
    text_.clear();
    ends_.clear();
}

void EntryList::reserve(std::size_t entries, std::size_t bytes)
{
    ends_.reserve(entries);
    if (bytes > text_.capacity())
        text_.reserve(bytes);
}

void EntryList::shiftEndsFrom(std::size_t row, std::ptrdiff_t change)
{
    for (auto i = row; i < ends_.size(); ++i)
        ends_[i] = static_cast<std::size_t>(static_cast<std::ptrdiff_t>(ends_[i]) + change);
}
