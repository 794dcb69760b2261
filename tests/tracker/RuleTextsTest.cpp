// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <fstream>
#include <set>
#include <sstream>

#include "RuleTexts.h"
#include "TrackerFixes.h"

namespace {

TEST(RuleTexts, EachIdHasOneTextWithEverySectionAndEachRepairOfFixSaysSo)
{
    std::set<std::string> ids;
    for (const auto& rule : RuleTexts()) {
        EXPECT_TRUE(ids.insert(rule.id).second) << rule.id;
        for (const char* text : {rule.title, rule.checks, rule.why, rule.repair, rule.example})
            EXPECT_GT(std::string(text).size(), 3u) << rule.id;
        EXPECT_EQ(FindRuleText(rule.id), &rule);
    }
    EXPECT_EQ(FindRuleText("numbers."), nullptr);
    for (const auto& fix : TrackerFixes())
        EXPECT_NE(std::string(FindRuleText(fix.id)->repair).find("quillmark-cli fix"), std::string::npos) << fix.id;
}

// docs/rules.md is generated from the program's texts and checked in: the two stay equal.
TEST(RuleTexts, DocsRulesMdHoldsTheProgramsTexts)
{
    std::ifstream file(QUILLMARK_DOCS_DIR "/rules.md", std::ios::binary);
    ASSERT_TRUE(file) << "no docs/rules.md";
    std::stringstream page;
    page << file.rdbuf();
    EXPECT_TRUE(page.str() == RulesMarkdown())
        << "docs/rules.md differs from the program's texts: quillmark-cli explain --markdown > docs/rules.md";
    for (const auto& rule : RuleTexts())
        EXPECT_NE(page.str().find("<a id=\"" + RuleAnchor(rule) + "\"></a>"), std::string::npos) << rule.id;
}

} // namespace
