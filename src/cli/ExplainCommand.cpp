// SPDX-License-Identifier: MIT
#include "ExplainCommand.h"

#include "CliFiles.h"
#include "ConsoleDialogs.h"
#include "RuleChoice.h"
#include "RuleTexts.h"

int RunExplain(const std::string& id, bool markdown, std::ostream& out, std::ostream& err)
{
    if (markdown) {
        out << RulesMarkdown();
        return ExitStatus::Ok;
    }
    if (id.empty()) {
        for (const auto& rule : RuleTexts())
            out << rule.id << "  " << rule.title << '\n';
        return ExitStatus::Ok;
    }
    const auto* rule = FindRuleText(id);
    if (rule == nullptr) {
        // A group ("numbers.") names rules too, but explain wants one.
        err << "quillmark-cli: " << UnknownRulePattern({id}).value_or("'" + ShownText(id) + "' is a group of rules")
            << "; quillmark-cli explain lists them\n";
        return ExitStatus::Usage;
    }
    out << ExplainText(*rule);
    return ExitStatus::Ok;
}
