// SPDX-License-Identifier: MIT
#include "ListKinds.h"

#include <iterator>

#include "Text.h"

namespace {

const ListKindInfo Infos[] = {
    {"category.txt", " Category", "Please enter the new category", "New Category", "LoadCategories"},
    {"parttype.txt", " Part Types", "Please enter the new part type", "New Part Type", "LoadPartTypes"},
    {"bfc.txt", " BFC", "Please enter the new BFC Statement", "New BFC Statement", "LoadBFC"},
    {"licenses.txt", " License Types", "Please enter the new license type", "New License Type", "LoadLicense"},
};

// "technic BEAM" becomes "Technic Beam": official categories have a capital on every word.
std::string capitaliseWords(const std::string& text)
{
    std::string result = ToLowerAscii(text);
    for (std::size_t i = 0; i < result.size(); ++i)
        if (i == 0 || result[i - 1] == ' ')
            result[i] = ToUpperAscii(std::string_view(&result[i], 1))[0];
    return result;
}

} // namespace

const ListKindInfo& InfoOf(ListKind kind) { return Infos[static_cast<int>(kind)]; }

std::string NormaliseEntry(ListKind kind, const std::string& trimmedText)
{
    switch (kind) {
    case ListKind::Category: return capitaliseWords(trimmedText);
    case ListKind::Bfc: return ToUpperAscii(trimmedText);
    case ListKind::PartType:
    case ListKind::License: return trimmedText;
    }
    return trimmedText;
}
