// SPDX-License-Identifier: MIT
#include "DescriptionTabs.h"

#include <algorithm>

#include "Dialogs.h"
#include "Text.h"

bool RemoveDescriptionTabs(HeaderData& header, Dialogs& dialogs)
{
    auto& description = header.PartDescription;
    if (description.find('\t') == std::string::npos)
        return false;
    dialogs.message(InformationBox(
        Translatable("Messages", "A TAB character was found in the Part Description and will be deleted")));
    description.erase(std::remove(description.begin(), description.end(), '\t'), description.end());
    // Blanks the tabs stood behind would end the line written, and the next open would drop them.
    description.resize(TrimTrailingBlanks(description).size());
    return true;
}
