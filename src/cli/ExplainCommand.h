// SPDX-License-Identifier: MIT
#pragma once

#include <ostream>
#include <string>

// explain: the rule id explained; every rule as docs/rules.md with markdown; without either, each
// id with its one-line title.
int RunExplain(const std::string& id, bool markdown, std::ostream& out, std::ostream& err);
