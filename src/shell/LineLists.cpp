// SPDX-License-Identifier: MIT
#include "LineLists.h"

#include "Dates.h"
#include "Text.h"

bool AddLineEntry(EntryList& list, const std::string& typed)
{
    const auto entry = TrimBlanks(typed);
    if (entry.empty())
        return false;
    list.push_back(entry);
    return true;
}

bool EditLineEntry(EntryList& list, std::size_t row, const std::string& typed)
{
    const auto entry = TrimBlanks(typed);
    if (entry.empty() || row >= list.size())
        return false;
    list.replace(row, entry);
    return true;
}

void DeleteLineEntry(EntryList& list, std::size_t row)
{
    if (row < list.size())
        list.erase(row);
}

std::string HistoryStub(const LocalDateTime& today, const std::string& userName)
{
    return FormatDate(today.year, today.month, today.day) + " [" + userName + "] ";
}
