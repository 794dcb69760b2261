// SPDX-License-Identifier: MIT
#include "ListEditor.h"

#include <algorithm>

#include "Dialogs.h"
#include "ErrorReport.h"
#include "StandardLists.h"
#include "Text.h"

namespace {

const char* const NoneEntry = "<none>";

} // namespace

bool ListOrderLess(const std::string& a, const std::string& b) { return ToLowerAscii(a) < ToLowerAscii(b); }

StringList SortedForDisplay(StringList entries)
{
    std::stable_sort(entries.begin(), entries.end(), ListOrderLess);
    return entries;
}

ListEditor::ListEditor(ListKind kind, const StringList& entries, std::string programFolder, Dialogs& dialogs)
    : kind_(kind), entries_(SortedForDisplay(entries)), programFolder_(std::move(programFolder)), dialogs_(dialogs)
{
}

void ListEditor::select(std::optional<std::size_t> row)
{
    selected_ = row && *row < entries_.size() ? row : std::nullopt;
    if (selected_)
        updateText_ = entries_[*selected_];
}

void ListEditor::add()
{
    const auto& info = InfoOf(kind_);
    const auto typed = std::string(TrimBlanks(dialogs_.input(info.addPrompt, info.addTitle, "")));
    if (typed.empty())
        return;
    const auto entry = NormaliseEntry(kind_, typed);
    if (contains(entry))
        return;
    const auto row = insertSorted(entry);
    if (selected_ && row <= *selected_)
        ++*selected_; // the selection stays on its entry
    changed_ = true;
}

void ListEditor::deleteSelected()
{
    if (!selected_ || refuseNone(Translatable("Messages", "Delete Entry"),
                                 Translatable("Messages", "The entry '<none>' is not allowed to delete.")))
        return;
    entries_.erase(entries_.begin() + static_cast<std::ptrdiff_t>(*selected_));
    selected_.reset();
    updateText_.clear();
    changed_ = true;
}

void ListEditor::updateSelected()
{
    if (!selected_ || refuseNone(Translatable("Messages", "Update Entry"),
                                 Translatable("Messages", "The entry '<none>' is not allowed to change.")))
        return;
    const auto typed = std::string(TrimBlanks(updateText_));
    if (typed.empty())
        return;
    const auto entry = NormaliseEntry(kind_, typed);
    if (entry == entries_[*selected_] || contains(entry))
        return;
    entries_.erase(entries_.begin() + static_cast<std::ptrdiff_t>(*selected_));
    selected_ = insertSorted(entry);
    updateText_ = entry;
    changed_ = true;
}

bool ListEditor::close()
{
    if (!changed_)
        return true;
    const auto answer = dialogs_.message({Translatable("Messages", "Do you want to save the changes to the list?"),
                                          Translatable("Messages", "Changed Categories"), Buttons::YesNoCancel,
                                          Icon::Question, Answer::Cancel});
    if (answer == Answer::Cancel)
        return false;
    if (answer == Answer::No)
        return true;
    try {
        WriteListFile(ListFilePath(programFolder_, kind_), entries_);
    } catch (const QmError& error) {
        ReportError(dialogs_, error, {"cmdClose_Click", OwnerKind::Formular, "frmList"});
        return false;
    }
    return true;
}

std::size_t ListEditor::insertSorted(const std::string& entry)
{
    const auto place = std::upper_bound(entries_.begin(), entries_.end(), entry, ListOrderLess);
    const auto row = static_cast<std::size_t>(place - entries_.begin());
    entries_.insert(place, entry);
    return row;
}

bool ListEditor::contains(const std::string& entry) const
{
    return std::find(entries_.begin(), entries_.end(), entry) != entries_.end();
}

bool ListEditor::refuseNone(const char* title, const char* refusal) const
{
    if (entries_[*selected_] != NoneEntry)
        return false;
    dialogs_.message({refusal, title, Buttons::Ok, Icon::Critical, Answer::Ok});
    return true;
}
