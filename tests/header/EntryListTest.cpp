// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <cstdint>
#include <string>
#include <vector>

#include "EntryList.h"

namespace {

template <typename List>
std::vector<std::string> entriesOf(const List& list)
{
    std::vector<std::string> entries;
    for (const auto entry : list)
        entries.emplace_back(entry);
    return entries;
}

using Entries = std::vector<std::string>;

TEST(EntryList, KeepsEntriesInOrderEmptyOnesIncluded)
{
    EntryList list{"0 COLOR a", "", "b"};
    list.push_back("longer entry");
    list.push_back("");
    EXPECT_EQ(entriesOf(list), (Entries{"0 COLOR a", "", "b", "longer entry", ""}));
    EXPECT_EQ(list.size(), 5u);
    EXPECT_EQ(list[3], "longer entry");
    list.clear();
    EXPECT_TRUE(list.empty());
    EXPECT_EQ(list.begin(), list.end());
}

TEST(EntryList, EditingOneEntryLeavesTheOthersAsTheyWere)
{
    EntryList list{"first", "second", "third", "fourth"};
    list.replace(1, "a much longer second");
    EXPECT_EQ(entriesOf(list), (Entries{"first", "a much longer second", "third", "fourth"}));
    list.replace(0, "1");
    list.replace(3, "");
    EXPECT_EQ(entriesOf(list), (Entries{"1", "a much longer second", "third", ""}));
    list.erase(1);
    EXPECT_EQ(entriesOf(list), (Entries{"1", "third", ""}));
    list.erase(0);
    list.erase(1);
    EXPECT_EQ(entriesOf(list), (Entries{"third"}));
    list.push_back("after");
    EXPECT_EQ(list, (EntryList{"third", "after"}));
}

TEST(EntryList, ListsAreEqualOnlyWithTheSameEntries)
{
    EXPECT_NE((EntryList{"ab", "c"}), (EntryList{"a", "bc"}));
    EXPECT_NE((EntryList{"a"}), (EntryList{"a", ""}));
    EXPECT_EQ((EntryList{"a", ""}), (EntryList{"a", ""}));
}

TEST(EntryList, RoomMadeAheadKeepsTheEntries)
{
    EntryList list{"x", "yz"};
    EXPECT_FALSE(list.fits(1u << 20));
    list.reserve(1000, 1u << 20);
    EXPECT_TRUE(list.fits(1u << 19));
    list.push_back("w");
    EXPECT_EQ(entriesOf(list), (Entries{"x", "yz", "w"}));
    EXPECT_EQ(list.textSize(), 4u);
}

// With offsets of one byte, an end passes what an offset holds every 256 bytes: the entries read
// back the same however far past that the text runs, an entry passing it twice included, and
// through edits that move the ends back and forth across it.
TEST(EntryList, EntriesPastWhatAnOffsetHoldsReadBackTheSame)
{
    BasicEntryList<std::uint8_t> list;
    Entries model;
    for (std::size_t i = 0; i < 40; ++i) {
        model.emplace_back(i * 7 % 30, static_cast<char>('a' + i % 26));
        list.push_back(model.back());
    }
    model.emplace_back(600, 'L');
    list.push_back(model.back());
    list.push_back("after");
    model.emplace_back("after");
    EXPECT_EQ(entriesOf(list), model);
    model[3] = std::string(300, 'R');
    list.replace(3, model[3]);
    EXPECT_EQ(entriesOf(list), model);
    model.erase(model.begin() + 40);
    list.erase(40);
    model.erase(model.begin());
    list.erase(0);
    model[2] = "";
    list.replace(2, "");
    EXPECT_EQ(entriesOf(list), model);
}

} // namespace
