// SPDX-License-Identifier: MIT
#include "HeaderEdits.h"

#include <algorithm>

#include "Dates.h"
#include "Text.h"

namespace {

// The day the library's contributor agreement put new work under CC BY 4.0 alone.
constexpr std::string_view CcBy4Since = "2023-03-05";

std::string joinKeywords(const StringList& keywords)
{
    std::string text;
    for (const auto& keyword : keywords)
        text += (text.empty() ? "" : ", ") + keyword;
    return text;
}

bool containsIgnoreCase(const StringList& list, const std::string& entry)
{
    const auto lower = ToLowerAscii(entry);
    return std::any_of(list.begin(), list.end(), [&lower](const auto& e) { return ToLowerAscii(e) == lower; });
}

void setAuthor(HeaderData& h, std::string_view author)
{
    author = TrimBlanks(author);
    const auto open = author.rfind('[');
    if (open == std::string_view::npos || !author.ends_with(']')) {
        h.AuthorRealName = author;
        return;
    }
    h.AuthorUserName = author.substr(open + 1, author.size() - open - 2);
    if (const auto realName = TrimBlanks(author.substr(0, open)); !realName.empty())
        h.AuthorRealName = realName;
}

// A history entry begins with its date, "YYYY-MM-DD".
bool datedSince(std::string_view entry, std::string_view day)
{
    const auto date = DateOfWord(entry.substr(0, entry.find(' ')));
    return date && *date >= day;
}

// A file under one of the library's current texts keeps it: CC BY 4.0 alone is never widened to
// CC BY 2.0 as well. Any other file was first published under CC BY 4.0 alone when its first
// history line dates from the contributor agreement on, otherwise under CC BY 2.0 as well.
std::string currentLicense(const HeaderData& h)
{
    if (h.License == Cc0License || h.License == CcBy4License)
        return h.License;
    const bool bornUnderCcBy4 = !h.History.empty() && datedSince(h.History[0], CcBy4Since);
    return std::string(bornUnderCcBy4 ? CcBy4License : CcBy2And4License);
}

void addKeywords(HeaderData& h, const StringList& keywords)
{
    if (keywords.empty())
        return;
    StringList present;
    for (const auto entry : h.Keywords)
        for (auto& keyword : SplitKeywords(entry))
            present.push_back(std::move(keyword));
    StringList added;
    for (const auto& keyword : keywords)
        if (!containsIgnoreCase(present, keyword) && !containsIgnoreCase(added, keyword))
            added.push_back(keyword);
    if (!added.empty())
        h.Keywords.push_back(joinKeywords(added));
}

// An entry keeps its own spelling unless one of its keywords goes; an entry left empty goes too.
void removeKeywords(HeaderData& h, const StringList& keywords)
{
    if (keywords.empty())
        return;
    EntryList kept;
    for (const auto entry : h.Keywords) {
        auto words = SplitKeywords(entry);
        const auto end = std::remove_if(words.begin(), words.end(),
                                        [&keywords](const auto& word) { return containsIgnoreCase(keywords, word); });
        if (end == words.end())
            kept.push_back(entry);
        else if (end != words.begin())
            kept.push_back(joinKeywords(StringList(words.begin(), end)));
    }
    h.Keywords = std::move(kept);
}

// CERTIFY CW and CERTIFY CCW are turned into each other only by reversing every polygon.
std::optional<std::string> windingTurned(const HeaderData& h, const HeaderEdits& edits)
{
    const auto from = ToUpperAscii(h.Bfc), to = edits.bfc ? ToUpperAscii(*edits.bfc) : from;
    const bool turned = (from == "CERTIFY CW" && to == "CERTIFY CCW") || (from == "CERTIFY CCW" && to == "CERTIFY CW");
    if (!turned)
        return std::nullopt;
    return "the BFC statement " + h.Bfc + " is not turned into " + *edits.bfc +
           ": that needs every polygon's winding reversed";
}

} // namespace

StringList SplitKeywords(std::string_view text)
{
    StringList keywords;
    for (std::size_t start = 0; start <= text.size();) {
        const auto comma = std::min(text.find(',', start), text.size());
        if (const auto keyword = TrimBlanks(text.substr(start, comma - start)); !keyword.empty())
            keywords.emplace_back(keyword);
        start = comma + 1;
    }
    return keywords;
}

std::string NameFolderOfType(std::string_view partType)
{
    constexpr std::string_view Unofficial = "Unofficial_";
    if (partType.starts_with(Unofficial))
        partType.remove_prefix(Unofficial.size());
    partType = partType.substr(0, partType.find(' '));
    if (partType == "Subpart")
        return "s\\";
    if (partType == "8_Primitive")
        return "8\\";
    if (partType == "48_Primitive")
        return "48\\";
    if (partType == "Helper")
        return "helpers\\";
    return "";
}

std::optional<std::string> EncodeHeaderEdits(HeaderEdits& edits, TextEncoding encoding)
{
    std::optional<std::string> unwritable;
    const auto encode = [&](std::string& value) {
        auto encoded = Utf8ToFileText(value, encoding);
        if (encoded)
            value = std::move(*encoded);
        else if (!unwritable)
            unwritable = value;
    };
    for (auto* value : {&edits.description, &edits.author, &edits.type, &edits.update, &edits.license, &edits.bfc,
                        &edits.category, &edits.addHistory})
        if (*value)
            encode(**value);
    for (auto* values : {&edits.addKeywords, &edits.removeKeywords})
        for (auto& value : *values)
            encode(value);
    encode(edits.historyUser);
    return unwritable;
}

std::optional<std::string> ApplyHeaderEdits(HeaderData& h, const HeaderEdits& edits, const LocalDateTime& today)
{
    if (auto refusal = windingTurned(h, edits))
        return refusal;
    const auto day = FormatDate(today.year, today.month, today.day);
    h.PartDescription = edits.description.value_or(h.PartDescription);
    if (edits.author)
        setAuthor(h, *edits.author);
    h.PartType = edits.type.value_or(h.PartType);
    h.UpdateTag = edits.update.value_or(h.UpdateTag);
    if (edits.license)
        h.License = *edits.license == CurrentLicense ? currentLicense(h) : *edits.license;
    h.Bfc = edits.bfc.value_or(h.Bfc);
    h.Category = edits.category.value_or(h.Category);
    addKeywords(h, edits.addKeywords);
    removeKeywords(h, edits.removeKeywords);
    if (edits.addHistory)
        h.History.push_back(day + " [" + edits.historyUser + "] " + *edits.addHistory);
    if (edits.nameFromPath)
        h.PartName = NameFolderOfType(h.PartType) + h.FilePath.substr(h.FilePath.rfind('/') + 1);
    return std::nullopt;
}
