// SPDX-License-Identifier: MIT
#include "Categories.h"

clsCategory& colCategory::Add(const std::string& Key, const std::string& Description)
{
    entries_.push_back({Key, Description});
    return entries_.back();
}
