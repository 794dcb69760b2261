// SPDX-License-Identifier: MIT
#pragma once

#include <cstdint>
#include <string>

#include "Categories.h"
#include "HeaderData.h"
#include "ListKinds.h"

class Dialogs;

// The allowed values of four header fields, each read from its file in the program's folder.
struct StandardLists {
    colCategory Categories;
    StringList PartTypes;
    StringList BfcStatements;
    StringList Licenses;
};

inline constexpr std::uintmax_t ListFileLimit = 1024 * 1024;

// One entry per line of the file, exactly as read: lines end at CR LF or a lone CR, nothing is
// trimmed or skipped. Throws QmError when the file cannot be read, and 75 naming the file when
// it is larger than ListFileLimit.
StringList ReadListFile(const std::string& path);

// Each entry followed by CR LF. Throws QmError when the file cannot be written.
void WriteListFile(const std::string& path, const StringList& entries);

std::string ListFilePath(const std::string& programFolder, ListKind kind);

// The loaders: the list from its file, or an empty list after the error report.
colCategory LoadCategories(const std::string& programFolder, Dialogs& dialogs);
StringList LoadPartTypes(const std::string& programFolder, Dialogs& dialogs);
StringList LoadBFC(const std::string& programFolder, Dialogs& dialogs);
StringList LoadLicense(const std::string& programFolder, Dialogs& dialogs);

// Reloads one list from its file into lists.
void ReloadList(StandardLists& lists, ListKind kind, const std::string& programFolder, Dialogs& dialogs);

// The texts a list shows, in the list's order (categories: their Description).
StringList EntriesOf(const StandardLists& lists, ListKind kind);

// The loading half of LadeHeaderStandards: part types, categories, BFC statements, licences.
void LoadStandardLists(StandardLists& lists, const std::string& programFolder, Dialogs& dialogs);
