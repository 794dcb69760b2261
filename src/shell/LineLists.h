// SPDX-License-Identifier: MIT
#pragma once

#include <optional>
#include <string>

#include "Clock.h"
#include "Dialogs.h"
#include "HeaderData.h"

// The keyword, comment and history lists as the window edits them: entries are stored trimmed,
// and Edit and Delete act on the selected row's own entry.

// Appends the trimmed text unless it is empty; true when something was added.
bool AddLineEntry(EntryList& list, const std::string& typed);
// Replaces entry row (from 0) by the trimmed text unless it is empty; true when it did.
bool EditLineEntry(EntryList& list, std::size_t row, const std::string& typed);
void DeleteLineEntry(EntryList& list, std::size_t row);

// Today's history line to start from: "YYYY-MM-DD [user] ".
std::string HistoryStub(const LocalDateTime& today, const std::string& userName);

inline constexpr const char* HistoryPrompt =
    Translatable("Messages", "Please enter !History string in the following format:") "\r\n" Translatable(
        "Messages", "'YYYY-MM-DD [Username] what's new/changed'");
