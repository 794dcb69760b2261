// SPDX-License-Identifier: MIT
#include "RuleChoice.h"

#include <algorithm>

#include "ClosestWord.h"
#include "ConsoleDialogs.h"
#include "RuleTexts.h"

namespace {

bool anyMatches(const std::vector<std::string>& patterns, std::string_view id)
{
    return std::any_of(patterns.begin(), patterns.end(),
                       [id](const std::string& pattern) { return PatternMatches(pattern, id); });
}

} // namespace

std::optional<FailOn> FailOnNamed(std::string_view name)
{
    if (name == "error")
        return FailOn::Error;
    if (name == "warning")
        return FailOn::Warning;
    if (name == "never")
        return FailOn::Never;
    return std::nullopt;
}

bool PatternMatches(std::string_view pattern, std::string_view id)
{
    return pattern.ends_with('.') ? id.starts_with(pattern) : id == pattern;
}

std::optional<std::string> UnknownRulePattern(const std::vector<std::string>& patterns)
{
    std::vector<std::string> known;
    for (const auto& rule : RuleTexts())
        known.emplace_back(rule.id);
    for (const auto& pattern : patterns) {
        if (std::any_of(known.begin(), known.end(), [&](const std::string& id) { return PatternMatches(pattern, id); }))
            continue;
        auto text = "'" + ShownText(pattern) + "' is no rule's id";
        if (const auto closest = ClosestWord(pattern, known); !closest.empty())
            text += "; did you mean '" + closest + "'?";
        return text;
    }
    return std::nullopt;
}

bool RuleChoice::reports(std::string_view id) const
{
    return (select.empty() || anyMatches(select, id)) && !anyMatches(ignore, id);
}

bool RuleChoice::fails(Severity severity) const
{
    switch (failOn) {
    case FailOn::Error: return severity == Severity::Error;
    case FailOn::Warning: return severity != Severity::Note;
    case FailOn::Never: break;
    }
    return false;
}
