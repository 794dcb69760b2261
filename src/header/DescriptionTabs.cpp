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
    return true;
}
