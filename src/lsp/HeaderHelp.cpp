// SPDX-License-Identifier: MIT
#include "HeaderHelp.h"

#include <array>

#include "Text.h"

namespace {

struct MetaHelp {
    std::string_view keyword;
    std::string_view help;
};

constexpr std::array<MetaHelp, 10> Helps{{
    {"Name:", "Name: the file's name as the library files it, with its folder for a subpart, primitive or "
              "helper (s\\, 8\\, 48\\, helpers\\), and the same as the file's own name."},
    {"Author:", "Author: the part's author as \"Real Name [UserName]\", the user name being the one registered "
                "at the Parts Tracker."},
    {"!LDRAW_ORG", "!LDRAW_ORG: the file's type (Part, Subpart, Primitive, ...), Unofficial_ before it until the "
                   "library releases it, a qualifier (Alias, Physical_Colour, Flexible_Section) where one applies, "
                   "and the release that last changed it (ORIGINAL or UPDATE YYYY-RR)."},
    {"!LICENSE", "!LICENSE: the licence the author grants the library; it accepts CC BY 4.0, CC BY 2.0 and "
                 "CC BY 4.0, or CC0 1.0, and a new file takes \"Licensed under CC BY 4.0 : see CAreadme.txt\"."},
    {"BFC", "BFC: the winding of the file's polygons; a new part is certified \"0 BFC CERTIFY CCW\", so that "
            "renderers can cull back faces."},
    {"!CATEGORY", "!CATEGORY: the part's category where the description's first word does not give it; it must "
                  "be one of the library's categories in force."},
    {"!KEYWORDS", "!KEYWORDS: words, separated by commas, that part searches find the part by, beyond its "
                  "description."},
    {"!HISTORY", "!HISTORY: one change of the file, \"YYYY-MM-DD [UserName] what changed\", oldest first; the "
                 "Parts Tracker adds these lines for the changes it records."},
    {"!HELP", "!HELP: a note for the part's users, such as how the part is used or built; several lines make "
              "one text."},
    {"!CMDLINE", "!CMDLINE: a command-line option LDraw programs apply when the file is opened on its own, as "
                 "\"-c16\" for its colour."},
}};

} // namespace

std::string MetaLineHelp(std::string_view line)
{
    line = TrimBlanks(line);
    if (!line.starts_with("0 "))
        return {};
    line = TrimBlanks(line.substr(2));
    for (const auto& [keyword, help] : Helps) {
        if (!line.starts_with(keyword))
            continue;
        const auto rest = line.substr(keyword.size());
        // A keyword ends at a blank or at the end of the line ("Name:" at its colon).
        if (keyword.ends_with(':') || rest.empty() || rest.front() == ' ')
            return std::string(help);
    }
    return {};
}
