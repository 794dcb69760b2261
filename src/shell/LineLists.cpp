// SPDX-License-Identifier: MIT
#include "LineLists.h"

#include <QString>

#include "Dates.h"
#include "Dialogs.h"
#include "MetaLine.h"
#include "Text.h"

namespace {

bool inTrackerHistoryForm(const std::string& typed)
{
    return IsHistoryLine(QString::fromUtf8("0 !HISTORY " + std::string(TrimBlanks(typed))));
}

} // namespace

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

std::string AskForLine(Dialogs& dialogs, const std::string& prompt, const std::string& title,
                       const std::string& defaultText, bool history)
{
    std::string typed = defaultText;
    for (;;) {
        typed = dialogs.input(prompt, title, typed);
        if (!history || TrimBlanks(typed).empty() || inTrackerHistoryForm(typed))
            return typed;
        const auto keep = dialogs.message(
            {"The Parts Tracker takes history lines only as \"YYYY-MM-DD [user] what changed\" (or {Real Name} "
             "in place of [user]), and would refuse\r\n" +
                 typed + "\r\nKeep it as it is?",
             "History", Buttons::YesNo, Icon::Exclamation, Answer::No});
        if (keep == Answer::Yes)
            return typed;
    }
}
