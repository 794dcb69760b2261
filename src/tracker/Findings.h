// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <cassert>
#include <string>
#include <vector>

#include "RuleTexts.h"
#include "TrackerCheck.h"

// Collects the findings of one file in the order the rules run.
class Findings {
public:
    void error(const char* id, std::string text, int line = 0) { add(id, FindingLevel::Error, std::move(text), line); }
    void warning(const char* id, std::string text, int line = 0)
    {
        add(id, FindingLevel::Warning, std::move(text), line);
    }
    void error(const char* id, const char* text, int line = 0) { error(id, std::string(text), line); }
    void warning(const char* id, const char* text, int line = 0) { warning(id, std::string(text), line); }
    void error(const char* id, const QString& text) { error(id, text.toStdString()); }
    void warning(const char* id, const QString& text) { warning(id, text.toStdString()); }
    bool empty() const { return list_.empty(); }
    std::vector<TrackerFinding> take() { return std::move(list_); }

private:
    void add(const char* id, FindingLevel level, std::string text, int line)
    {
        // Every id is explained (quillmark-cli explain, SARIF, docs/rules.md): a new rule brings its text.
        assert(FindRuleText(id) != nullptr);
        list_.push_back({id, level, std::move(text), line});
    }
    std::vector<TrackerFinding> list_;
};
