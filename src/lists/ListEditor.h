// SPDX-License-Identifier: MIT
#pragma once

#include <optional>
#include <string>

#include "HeaderData.h"
#include "ListKinds.h"

class Dialogs;

// The rules of the list dialog, without the dialog: a working copy of one standard list, kept
// sorted ascending without regard to letter case as the dialog's list shows it, and the Add,
// Delete, Update and Close actions. The file is written only when Close is answered with Yes.
class ListEditor {
public:
    ListEditor(ListKind kind, const StringList& entries, std::string programFolder, Dialogs& dialogs);

    bool ListChanged() const { return changed_; }
    const StringList& entries() const { return entries_; }
    std::optional<std::size_t> selected() const { return selected_; }
    // The text of txUpdate: the selected entry's, or what the user typed there.
    const std::string& updateText() const { return updateText_; }

    void select(std::optional<std::size_t> row);
    void setUpdateText(const std::string& text) { updateText_ = text; }

    void add();
    void deleteSelected();
    void updateSelected();
    // True when the dialog may close; false when it stays open (Cancel, or the file could not be written).
    bool close();

private:
    std::size_t insertSorted(const std::string& entry); // returns its row
    bool contains(const std::string& entry) const;
    // Tells the user that "<none>" cannot be changed or deleted (refusal) when it is the selected entry.
    bool refuseNone(const char* title, const char* refusal) const;

    ListKind kind_;
    StringList entries_;
    std::string programFolder_;
    Dialogs& dialogs_;
    bool changed_ = false;
    std::optional<std::size_t> selected_;
    std::string updateText_;
};

// The order of the list dialog and the drop-down lists: ascending, ASCII letters without regard to case.
bool ListOrderLess(const std::string& a, const std::string& b);
StringList SortedForDisplay(StringList entries);
