// SPDX-License-Identifier: MIT
#pragma once

#include <set>
#include <string>
#include <utility>
#include <vector>

#include "TrackerCheck.h"

inline const StringList Categories = {
    "<none>",           "Brick",  "Hose", "Technic", "Moved", "Obsolete", "Cylinder", "Minifig Accessory",
    "Sticker Shortcut", "Vehicle"};

// The colour codes 0 to 511, as a small LDConfig.ldr would give them.
const ColourCodes& Colours();

// A header the Tracker accepts (seven lines and a blank one), extra lines, then a body line.
std::string cleanPart(const std::string& description = "Brick  2 x  4", const std::string& name = "3001.dat",
                      const std::string& type = "Part", const std::string& extra = "");

using Ids = std::set<std::string>;
Ids idsOf(const std::string& text, const std::string& fileName = "3001.dat");

// The findings about body lines of a clean part whose body is body, numbered from its first line.
using LineIds = std::vector<std::pair<int, std::string>>;
LineIds bodyFindings(const std::string& body, const ColourCodes& colours = Colours());
