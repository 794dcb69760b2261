// SPDX-License-Identifier: MIT
#include "Composer.h"

#include "Text.h"

namespace {

// One line of pieces. Appending piece by piece (never "a" + b) keeps a field of many megabytes
// from being copied into a temporary first.
void addLine(std::string& text, std::initializer_list<std::string_view> pieces)
{
    for (const auto piece : pieces)
        text += piece;
    text += CrLf;
}

// One "prefix + entry" line per entry; true when anything was written.
bool addPrefixedLines(std::string& text, std::string_view prefix, const EntryList& entries)
{
    for (const auto entry : entries)
        addLine(text, {prefix, entry});
    return !entries.empty();
}

// At least the size of the composed header, so that the text is allocated once.
std::size_t sizeBound(const HeaderData& h)
{
    constexpr std::size_t perLine = 32; // the longest keyword with its blanks and CR LF, and then some
    std::size_t size = 512;
    for (const std::string* field : {&h.PartDescription, &h.PartName, &h.AuthorRealName, &h.AuthorUserName, &h.PartType,
                                     &h.UpdateTag, &h.License, &h.Bfc, &h.Category})
        size += field->size() + perLine;
    for (const EntryList* list : {&h.HelpLines, &h.Keywords, &h.CmdLines, &h.History, &h.Comments, &h.ColorLines})
        size += list->textSize() + list->size() * perLine;
    return size;
}

void endGroup(std::string& text, bool groupWroteLines)
{
    if (groupWroteLines)
        text += CrLf;
}

void addIdentification(std::string& text, const HeaderData& h)
{
    addLine(text, {"0 ", h.PartDescription});
    addLine(text, {"0 Name: ", h.PartName});
    if (h.AuthorRealName.empty())
        addLine(text, {"0 Author: Unknown"});
    else if (h.AuthorUserName.empty())
        addLine(text, {"0 Author: ", h.AuthorRealName});
    else
        addLine(text, {"0 Author: ", h.AuthorRealName, " [", h.AuthorUserName, "]"});
    if (!h.PartType.empty()) {
        // Unofficial part types never carry an update tag.
        const bool withUpdate = !h.UpdateTag.empty() && h.PartType.compare(0, 3, "Uno") != 0;
        if (withUpdate)
            addLine(text, {"0 !LDRAW_ORG ", h.PartType, " UPDATE ", h.UpdateTag});
        else
            addLine(text, {"0 !LDRAW_ORG ", h.PartType});
    }
    if (!h.License.empty())
        addLine(text, {"0 !LICENSE ", h.License});
    text += CrLf;
}

bool addCategoryAndKeywords(std::string& text, const HeaderData& h)
{
    const bool withCategory = !h.Category.empty() && h.Category != "<none>";
    if (withCategory)
        addLine(text, {"0 !CATEGORY ", h.Category});
    return addPrefixedLines(text, "0 !KEYWORDS ", h.Keywords) || withCategory;
}

// Comments read from the file keep their "//"; typed ones get it here.
bool addComments(std::string& text, const HeaderData& h)
{
    for (const auto entry : h.Comments)
        addLine(text, {entry.starts_with("//") ? "0 " : "0 // ", entry});
    return !h.Comments.empty();
}

} // namespace

std::string ComposeHeader(const HeaderData& h)
{
    std::string text;
    text.reserve(sizeBound(h));
    addIdentification(text, h);
    endGroup(text, addPrefixedLines(text, "0 !HELP ", h.HelpLines));
    if (!h.Bfc.empty()) {
        addLine(text, {"0 BFC ", h.Bfc});
        text += CrLf;
    }
    endGroup(text, addCategoryAndKeywords(text, h));
    endGroup(text, addPrefixedLines(text, "0 !CMDLINE ", h.CmdLines));
    endGroup(text, addPrefixedLines(text, "0 !HISTORY ", h.History));
    endGroup(text, addComments(text, h));
    for (const auto colorLine : h.ColorLines)
        if (!colorLine.empty())
            addLine(text, {colorLine});
    return text;
}
