// SPDX-License-Identifier: MIT
#include "TrackerTestParts.h"

#include <numeric>

const ColourCodes& Colours()
{
    static const ColourCodes codes([] {
        std::vector<long> all(512);
        std::iota(all.begin(), all.end(), 0);
        return all;
    }());
    return codes;
}

std::string cleanPart(const std::string& description, const std::string& name, const std::string& type,
                      const std::string& extra)
{
    return "0 " + description + "\r\n0 Name: " + name + "\r\n0 Author: Jane Doe [jdoe]\r\n0 !LDRAW_ORG " + type +
           "\r\n0 !LICENSE Licensed under CC BY 4.0 : see CAreadme.txt\r\n\r\n0 BFC CERTIFY CCW\r\n\r\n" + extra +
           "1 16 0 0 0 1 0 0 0 1 0 0 0 1 stud.dat\r\n";
}

Ids idsOf(const std::string& text, const std::string& fileName)
{
    Ids ids;
    for (const auto& finding : CheckForTracker(text, fileName, Categories, Colours()))
        ids.insert(finding.id);
    return ids;
}

LineIds bodyFindings(const std::string& body, const ColourCodes& colours)
{
    const auto text = cleanPart("Brick  2 x  4", "3001.dat", "Part", body);
    constexpr int HeaderLines = 8;
    LineIds found;
    for (const auto& finding : CheckForTracker(text, "3001.dat", Categories, colours))
        found.emplace_back(finding.line == 0 ? 0 : finding.line - HeaderLines, finding.id);
    return found;
}
