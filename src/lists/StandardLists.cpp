// SPDX-License-Identifier: MIT
#include "StandardLists.h"

#include <filesystem>

#include "ErrorReport.h"
#include "LineReader.h"
#include "PartFile.h"
#include "SafeReplace.h"

namespace {

StringList loadList(ListKind kind, const std::string& programFolder, Dialogs& dialogs)
{
    try {
        return ReadListFile(ListFilePath(programFolder, kind));
    } catch (const QmError& error) {
        ReportError(dialogs, error, {InfoOf(kind).loaderName, OwnerKind::Modul, "modCategory"});
        return {};
    }
}

} // namespace

StringList ReadListFile(const std::string& path)
{
    // A list is a few hundred short lines; a file far larger is no list, and its lines would take
    // many times its size in memory. A file that cannot be looked at is left to the reading.
    std::error_code unknown;
    if (const auto size = std::filesystem::file_size(path, unknown); !unknown && size > ListFileLimit)
        throw QmError(ErrorNumber::PathFileAccessError, "The list file " + path + " is larger than 1 MB");
    const FileBytes bytes(path);
    StringList entries;
    LineReader reader(bytes.view());
    while (!reader.atEnd())
        entries.emplace_back(reader.nextLine());
    return entries;
}

void WriteListFile(const std::string& path, const StringList& entries)
{
    std::string text;
    for (const auto& entry : entries)
        text.append(entry).append("\r\n");
    ReplaceFileSafely(path, {text});
}

std::string ListFilePath(const std::string& programFolder, ListKind kind)
{
    return programFolder + "/" + InfoOf(kind).fileName;
}

colCategory LoadCategories(const std::string& programFolder, Dialogs& dialogs)
{
    colCategory categories;
    for (const auto& line : loadList(ListKind::Category, programFolder, dialogs))
        categories.Add("", line);
    return categories;
}

StringList LoadPartTypes(const std::string& programFolder, Dialogs& dialogs)
{
    return loadList(ListKind::PartType, programFolder, dialogs);
}

StringList LoadBFC(const std::string& programFolder, Dialogs& dialogs)
{
    return loadList(ListKind::Bfc, programFolder, dialogs);
}

StringList LoadLicense(const std::string& programFolder, Dialogs& dialogs)
{
    return loadList(ListKind::License, programFolder, dialogs);
}

void ReloadList(StandardLists& lists, ListKind kind, const std::string& programFolder, Dialogs& dialogs)
{
    switch (kind) {
    case ListKind::Category: lists.Categories = LoadCategories(programFolder, dialogs); break;
    case ListKind::PartType: lists.PartTypes = LoadPartTypes(programFolder, dialogs); break;
    case ListKind::Bfc: lists.BfcStatements = LoadBFC(programFolder, dialogs); break;
    case ListKind::License: lists.Licenses = LoadLicense(programFolder, dialogs); break;
    }
}

StringList EntriesOf(const StandardLists& lists, ListKind kind)
{
    switch (kind) {
    case ListKind::Category: {
        StringList texts;
        for (const auto& category : lists.Categories)
            texts.push_back(category.Description);
        return texts;
    }
    case ListKind::PartType: return lists.PartTypes;
    case ListKind::Bfc: return lists.BfcStatements;
    case ListKind::License: return lists.Licenses;
    }
    return {};
}

void LoadStandardLists(StandardLists& lists, const std::string& programFolder, Dialogs& dialogs)
{
    for (const auto kind : {ListKind::PartType, ListKind::Category, ListKind::Bfc, ListKind::License})
        ReloadList(lists, kind, programFolder, dialogs);
}
