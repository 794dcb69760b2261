// SPDX-License-Identifier: MIT
#include "ListKinds.h"

#include <iterator>

#include "Dialogs.h"
#include "Text.h"

namespace {

const ListKindInfo Infos[] = {
    {"category.txt", Translatable("frmList", " Category"), Translatable("Messages", "Please enter the new category"),
     Translatable("Messages", "New Category"), "LoadCategories"},
    {"parttype.txt", Translatable("frmList", " Part Types"), Translatable("Messages", "Please enter the new part type"),
     Translatable("Messages", "New Part Type"), "LoadPartTypes"},
    {"bfc.txt", Translatable("frmList", " BFC"), Translatable("Messages", "Please enter the new BFC Statement"),
     Translatable("Messages", "New BFC Statement"), "LoadBFC"},
    {"licenses.txt", Translatable("frmList", " License Types"),
     Translatable("Messages", "Please enter the new license type"), Translatable("Messages", "New License Type"),
     "LoadLicense"},
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
