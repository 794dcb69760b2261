// SPDX-License-Identifier: MIT
#pragma once

#include <string>

// The four standard lists and what differs between them.
enum class ListKind { Category, PartType, Bfc, License };
inline constexpr ListKind AllListKinds[] = {ListKind::Category, ListKind::PartType, ListKind::Bfc, ListKind::License};

struct ListKindInfo {
    const char* fileName;      // in the list folder
    const char* captionSuffix; // appended to the list dialog's caption "List"
    const char* addPrompt;
    const char* addTitle;
    const char* loaderName; // the loader named in its error report
};

const ListKindInfo& InfoOf(ListKind kind);

// How a typed entry is written into the list: categories capitalise every word, BFC statements
// are upper case, part types and licences stay as typed.
std::string NormaliseEntry(ListKind kind, const std::string& trimmedText);
