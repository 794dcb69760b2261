// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "HeaderData.h"

// What the completion of a header line offers, from the lists the window offers.
struct CompletionLists {
    StringList partTypes; // with their qualifiers, as the part type list holds them
    StringList licences;
    StringList bfcStatements;
    StringList categories;    // in force: the retired ones left out
    std::string historyStart; // "YYYY-MM-DD [user] " of today
};

// The categories an author may choose: the list's entries without the retired ones and the
// window's "<none>".
StringList CategoriesInForce(StringList categories);

// The texts that may follow the start of a line (the bytes before the cursor), and how many of
// the start's last bytes each replaces (the part of the value typed so far).
struct Completions {
    std::vector<std::string> texts;
    std::size_t typed = 0;
};
Completions CompleteHeaderLine(std::string_view lineStart, const CompletionLists& lists);
