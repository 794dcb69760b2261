// SPDX-License-Identifier: MIT
#include "LineLists.h"

#include "Dates.h"
#include "Text.h"

bool AddLineEntry(StringList& list, const std::string& typed)
{
    const auto entry = TrimBlanks(typed);
    if (entry.empty())
        return false;
    list.emplace_back(entry);
    return true;
}

bool EditLineEntry(StringList& list, std::size_t row, const std::string& typed)
{
    const auto entry = TrimBlanks(typed);
    if (entry.empty() || row >= list.size())
        return false;
    list[row] = entry;
    return true;
}

void DeleteLineEntry(StringList& list, std::size_t row)
{
    if (row < list.size())
        list.erase(list.begin() + static_cast<std::ptrdiff_t>(row));
}

std::string HistoryStub(const LocalDateTime& today, const std::string& userName)
{
    return FormatDate(today.year, today.month, today.day) + " [" + userName + "] ";
}
