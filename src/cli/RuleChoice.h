// SPDX-License-Identifier: MIT
#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "FileFindings.h"

// Which findings a check reports and which of them fail it. A pattern names one id, or, ending
// in ".", every id that begins with it ("numbers.", "save.").

enum class FailOn { Error, Warning, Never };

// The severity from which findings fail the check: "error", "warning" or "never".
std::optional<FailOn> FailOnNamed(std::string_view name);

// The first pattern that names no id a check can report, with the nearest id in words
// ("'numbers.leadingzero' is no rule's id; did you mean 'numbers.leadingzeros'?"); none when all do.
std::optional<std::string> UnknownRulePattern(const std::vector<std::string>& patterns);

bool PatternMatches(std::string_view pattern, std::string_view id);

struct RuleChoice {
    std::vector<std::string> select = {}; // empty: every rule
    std::vector<std::string> ignore = {};
    FailOn failOn = FailOn::Error;

    bool reports(std::string_view id) const;
    bool fails(Severity severity) const;
};
