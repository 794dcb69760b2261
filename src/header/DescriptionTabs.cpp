// SPDX-License-Identifier: MIT
#include "DescriptionTabs.h"

#include <algorithm>

#include "Dialogs.h"

bool RemoveDescriptionTabs(HeaderData& header, Dialogs& dialogs)
{
    auto& description = header.PartDescription;
    if (description.find('\t') == std::string::npos)
        return false;
    dialogs.message(InformationBox("A TAB character was found in the Part Description and will be deleted"));
    description.erase(std::remove(description.begin(), description.end(), '\t'), description.end());
    // Blanks the tabs stood behind would end the line written, and the next open would drop them.
    description.erase(description.find_last_not_of(' ') + 1);
    return true;
}
