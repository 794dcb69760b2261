// SPDX-License-Identifier: MIT
#pragma once

#include <string>
#include <string_view>

// The changes from before to after as "diff -u" shows them (three lines of context, lines ending
// at LF, a CR kept in its line), headed "--- from" and "+++ to". Empty when the two are equal. Past
// some thousands of differing lines the changed stretch is shown as one replacement instead of the
// shortest one.
std::string UnifiedDiff(std::string_view before, std::string_view after, const std::string& from,
                        const std::string& to);
