// SPDX-License-Identifier: MIT
#pragma once

#include <span>
#include <string>
#include <string_view>

// What each id a check can report means, in words for people: the save checks ("save.*"), the
// fix-ups a save offers ("save.fixup.*") and the Parts Tracker's rules. The command line's
// explain, the SARIF rules, docs/rules.md and the language server's hovers all show these texts.
struct RuleText {
    const char* id;
    const char* title;   // one sentence: what a finding says is wrong
    const char* checks;  // what the rule checks, exactly
    const char* why;     // why the library has the rule
    const char* repair;  // whether a command repairs it, and how
    const char* example; // a line or a header that has the finding
};

// Every id a check can report, the save checks first, then the Tracker's rules by their ids.
std::span<const RuleText> RuleTexts();

// The text of an id; null when no check reports it.
const RuleText* FindRuleText(std::string_view id);

// The anchor of the rule's section in docs/rules.md.
std::string RuleAnchor(const RuleText& rule);

// What the rule checks and why, as one paragraph.
std::string RuleDescription(const RuleText& rule);

// The whole explanation as plain text, as `quillmark-cli explain ID` prints it.
std::string ExplainText(const RuleText& rule);

// The explanation as a Markdown section, and docs/rules.md: every section after a short preface.
std::string RuleMarkdown(const RuleText& rule);
std::string RulesMarkdown();
