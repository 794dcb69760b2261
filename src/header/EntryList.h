// SPDX-License-Identifier: MIT
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <initializer_list>
#include <iterator>
#include <limits>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

// The entries of one of the header's lists, in order. A header can hold millions of short lines:
// the entries stand back to back in one text, each known by where it ends, so that an entry costs
// its bytes and one offset rather than a string of its own.
//
// Each end is kept in an Offset. What lies beyond an Offset's range is kept apart, as the rows
// at which the ends pass another multiple of that range: a list that stays empty until the
// entries of one list take 4 GiB.
template <typename Offset>
class BasicEntryList {
public:
    class Iterator {
    public:
        using iterator_category = std::forward_iterator_tag;
        using value_type = std::string_view;
        using difference_type = std::ptrdiff_t;
        using pointer = void;
        using reference = std::string_view;

        Iterator() = default;
        Iterator(const BasicEntryList& list, std::size_t row) : list_(&list), row_(row) {}
        std::string_view operator*() const { return (*list_)[row_]; }
        Iterator& operator++()
        {
            ++row_;
            return *this;
        }
        Iterator operator++(int)
        {
            auto before = *this;
            ++row_;
            return before;
        }
        bool operator==(const Iterator& other) const { return row_ == other.row_; }

    private:
        const BasicEntryList* list_ = nullptr;
        std::size_t row_ = 0;
    };
    using value_type = std::string_view;
    using iterator = Iterator;
    using const_iterator = Iterator;

    BasicEntryList() = default;
    BasicEntryList(std::initializer_list<std::string_view> entries)
    {
        for (const auto entry : entries)
            push_back(entry);
    }

    std::size_t size() const { return ends_.size(); }
    bool empty() const { return ends_.empty(); }
    // Entry row, from 0; the view is valid until the list changes.
    std::string_view operator[](std::size_t row) const
    {
        const auto start = row == 0 ? 0 : endOf(row - 1);
        return std::string_view(text_).substr(start, endOf(row) - start);
    }
    Iterator begin() const { return {*this, 0}; }
    Iterator end() const { return {*this, size()}; }
    // The bytes of all entries together.
    std::size_t textSize() const { return text_.size(); }

    void push_back(std::string_view entry) { pushPieces({entry}); }
    // Adds the entry made of the pieces one after another, written where it is kept.
    void pushPieces(std::initializer_list<std::string_view> pieces)
    {
        for (const auto piece : pieces)
            text_ += piece;
        ends_.push_back(0);
        setEnd(ends_.size() - 1, text_.size());
    }
    void replace(std::size_t row, std::string_view entry) { change(row, entry); }
    void erase(std::size_t row) { change(row, std::nullopt); }
    void clear()
    {
        text_.clear();
        ends_.clear();
        carries_.clear();
    }

    // True when one more entry of entrySize bytes fits in the room the list holds.
    bool fits(std::size_t entrySize) const
    {
        return ends_.size() < ends_.capacity() && text_.size() + entrySize <= text_.capacity();
    }
    // Room for at least entries entries of bytes bytes in all.
    void reserve(std::size_t entries, std::size_t bytes)
    {
        ends_.reserve(entries);
        if (bytes > text_.capacity())
            text_.reserve(bytes);
    }

    bool operator==(const BasicEntryList& other) const = default;

private:
    static constexpr std::size_t OffsetBits = std::numeric_limits<Offset>::digits;
    static constexpr std::size_t OffsetMask = std::numeric_limits<Offset>::max();

    std::size_t endOf(std::size_t row) const
    {
        const auto carried = std::upper_bound(carries_.begin(), carries_.end(), row) - carries_.begin();
        return ends_[row] + (static_cast<std::size_t>(carried) << OffsetBits);
    }
    // Row's end, as the last one set so far: the rows after it are set after it.
    void setEnd(std::size_t row, std::size_t end)
    {
        while (carries_.size() < end >> OffsetBits)
            carries_.push_back(row);
        ends_[row] = static_cast<Offset>(end & OffsetMask);
    }
    // Puts replacement in the place of entry row, or takes the row out when there is none.
    void change(std::size_t row, std::optional<std::string_view> replacement)
    {
        std::vector<std::size_t> ends(ends_.size());
        for (std::size_t i = 0; i < ends.size(); ++i)
            ends[i] = endOf(i);
        const auto start = row == 0 ? 0 : ends[row - 1];
        const auto oldSize = ends[row] - start;
        const auto newText = replacement.value_or(std::string_view());
        text_.replace(start, oldSize, newText);
        if (!replacement)
            ends.erase(ends.begin() + static_cast<std::ptrdiff_t>(row));
        for (auto i = row; i < ends.size(); ++i)
            ends[i] = ends[i] - oldSize + newText.size();
        carries_.clear();
        ends_.resize(ends.size());
        for (std::size_t i = 0; i < ends.size(); ++i)
            setEnd(i, ends[i]);
    }

    std::string text_;
    std::vector<Offset> ends_;
    std::vector<std::size_t> carries_; // ascending; a row stands once for each multiple its end passes
};

// Four bytes of offset per entry, half of what a std::size_t takes: the most that an entry of a
// one-word line costs. The tests use smaller offsets to pass their range within a few entries.
using EntryList = BasicEntryList<std::uint32_t>;
