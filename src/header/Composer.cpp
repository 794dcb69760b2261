#include "Composer.h"

#include "Text.h"

namespace {

void addLine(std::string& text, std::string_view line)
{
    text += line;
    text += CrLf;
}

// One "prefix + entry" line per entry; true when anything was written.
bool addPrefixedLines(std::string& text, std::string_view prefix, const StringList& entries)
{
    for (const auto& entry : entries) {
        text += prefix;
        addLine(text, entry);
    }
    return !entries.empty();
}

void endGroup(std::string& text, bool groupWroteLines)
{
    if (groupWroteLines)
        text += CrLf;
}

void addIdentification(std::string& text, const HeaderData& h)
{
    addLine(text, "0 " + h.PartDescription);
    addLine(text, "0 Name: " + h.PartName);
    if (h.AuthorRealName.empty())
        addLine(text, "0 Author: Unknown");
    else if (h.AuthorUserName.empty())
        addLine(text, "0 Author: " + h.AuthorRealName);
    else
        addLine(text, "0 Author: " + h.AuthorRealName + " [" + h.AuthorUserName + "]");
    if (!h.PartType.empty()) {
        // Unofficial part types never carry an update tag.
        const bool withUpdate = !h.UpdateTag.empty() && h.PartType.compare(0, 3, "Uno") != 0;
        addLine(text, "0 !LDRAW_ORG " + h.PartType + (withUpdate ? " UPDATE " + h.UpdateTag : std::string()));
    }
    if (!h.License.empty())
        addLine(text, "0 !LICENSE " + h.License);
    text += CrLf;
}

bool addCategoryAndKeywords(std::string& text, const HeaderData& h)
{
    const bool withCategory = !h.Category.empty() && h.Category != "<none>";
    if (withCategory)
        addLine(text, "0 !CATEGORY " + h.Category);
    return addPrefixedLines(text, "0 !KEYWORDS ", h.Keywords) || withCategory;
}

// Comments read from the file keep their "//"; typed ones get it here.
bool addComments(std::string& text, const HeaderData& h)
{
    for (const auto& entry : h.Comments)
        addLine(text, (entry.compare(0, 2, "//") == 0 ? "0 " : "0 // ") + entry);
    return !h.Comments.empty();
}

} // namespace

std::string ComposeHeader(const HeaderData& h)
{
    std::string text;
    addIdentification(text, h);
    endGroup(text, addPrefixedLines(text, "0 !HELP ", h.HelpLines));
    if (!h.Bfc.empty()) {
        addLine(text, "0 BFC " + h.Bfc);
        text += CrLf;
    }
    endGroup(text, addCategoryAndKeywords(text, h));
    endGroup(text, addPrefixedLines(text, "0 !CMDLINE ", h.CmdLines));
    endGroup(text, addPrefixedLines(text, "0 !HISTORY ", h.History));
    endGroup(text, addComments(text, h));
    for (const auto& colorLine : h.ColorLines)
        if (!colorLine.empty())
            addLine(text, colorLine);
    return text;
}
