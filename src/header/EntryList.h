// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <initializer_list>
#include <iterator>
#include <string>
#include <string_view>
#include <vector>

// The entries of one of the header's lists, in order. A header can hold millions of short lines:
// the entries stand back to back in one text, each known by where it ends, so that an entry costs
// its bytes and one offset rather than a string of its own.
class EntryList {
public:
    class Iterator {
    public:
        using iterator_category = std::forward_iterator_tag;
        using value_type = std::string_view;
        using difference_type = std::ptrdiff_t;
        using pointer = void;
        using reference = std::string_view;

        Iterator() = default;
        Iterator(const EntryList& list, std::size_t row) : list_(&list), row_(row) {}
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
        const EntryList* list_ = nullptr;
        std::size_t row_ = 0;
    };
    using value_type = std::string_view;
    using iterator = Iterator;
    using const_iterator = Iterator;

    EntryList() = default;
    EntryList(std::initializer_list<std::string_view> entries);

    std::size_t size() const { return ends_.size(); }
    bool empty() const { return ends_.empty(); }
    // Entry row, from 0; the view is valid until the list changes.
    std::string_view operator[](std::size_t row) const
    {
        const auto start = startOf(row);
        return std::string_view(text_).substr(start, ends_[row] - start);
    }
    Iterator begin() const { return {*this, 0}; }
    Iterator end() const { return {*this, size()}; }
    // The bytes of all entries together.
    std::size_t textSize() const { return text_.size(); }

    void push_back(std::string_view entry) { pushPieces({entry}); }
    // Adds the entry made of the pieces one after another, written where it is kept.
    void pushPieces(std::initializer_list<std::string_view> pieces);
    void replace(std::size_t row, std::string_view entry);
    void erase(std::size_t row);
    void clear();

    // True when one more entry of entrySize bytes fits in the room the list holds.
    bool fits(std::size_t entrySize) const
    {
        return ends_.size() < ends_.capacity() && text_.size() + entrySize <= text_.capacity();
    }
    // Room for at least entries entries of bytes bytes in all.
    void reserve(std::size_t entries, std::size_t bytes);

    bool operator==(const EntryList& other) const = default;

private:
    std::size_t startOf(std::size_t row) const { return row == 0 ? 0 : ends_[row - 1]; }
    // Moves the ends of row and the entries after it by change bytes.
    void shiftEndsFrom(std::size_t row, std::ptrdiff_t change);

    std::string text_;
    std::vector<std::size_t> ends_;
};
