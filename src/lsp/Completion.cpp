// SPDX-License-Identifier: MIT
#include "Completion.h"

#include <array>

#include "HeaderFacts.h"
#include "Text.h"

namespace {

constexpr std::array<std::string_view, 10> HeaderKeywords{"Name: ", "Author: ",   "!LDRAW_ORG ", "!LICENSE ",
                                                          "BFC ",   "!CATEGORY ", "!KEYWORDS ",  "!HISTORY ",
                                                          "!HELP ", "!CMDLINE "};

// The entries that start with what was typed (in any case).
std::vector<std::string> startingWith(const StringList& entries, std::string_view typed)
{
    std::vector<std::string> found;
    for (const auto& entry : entries)
        if (StartsWithIgnoreCase(entry, typed))
            found.push_back(entry);
    return found;
}

} // namespace

StringList CategoriesInForce(StringList categories)
{
    std::erase_if(categories, [](const std::string& category) {
        return category.starts_with('<') || RetiredCategories.contains(QString::fromStdString(category));
    });
    return categories;
}

Completions CompleteHeaderLine(std::string_view lineStart, const CompletionLists& lists)
{
    if (!lineStart.starts_with("0 "))
        return {};
    const auto rest = lineStart.substr(2);
    const auto blank = rest.find(' ');
    if (blank == std::string_view::npos) {
        std::vector<std::string> keywords;
        for (const auto keyword : HeaderKeywords)
            if (StartsWithIgnoreCase(keyword, rest))
                keywords.emplace_back(keyword);
        return {keywords, rest.size()};
    }
    const auto keyword = rest.substr(0, blank);
    const auto value = rest.substr(blank + 1);
    const StringList* list = nullptr;
    if (keyword == "!LDRAW_ORG")
        list = &lists.partTypes;
    else if (keyword == "!LICENSE")
        list = &lists.licences;
    else if (keyword == "BFC")
        list = &lists.bfcStatements;
    else if (keyword == "!CATEGORY")
        list = &lists.categories;
    else if (keyword == "!HISTORY" && lists.historyStart.starts_with(value))
        return {{lists.historyStart}, value.size()};
    if (list == nullptr)
        return {};
    return {startingWith(*list, value), value.size()};
}
