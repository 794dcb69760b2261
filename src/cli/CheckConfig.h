// SPDX-License-Identifier: MIT
#pragma once

#include <map>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <utility>
#include <variant>
#include <vector>

#include "RuleChoice.h"

// quillmark.toml: the settings of check for the files in its folder and below, as ruff and
// EditorConfig find theirs. Every key is optional:
//
//   select = ["numbers.", "license.approved"]   # only these rules (a "." ends a group)
//   ignore = ["warning.notcoplaner"]
//   fail-on = "warning"                          # error (the default), warning or never
//   length-limit = false                         # descriptions of any length
//   ldconfig = "../LDConfig.ldr"                 # relative to the file's folder
//   [per-file-ignores]
//   "p/*" = ["numbers.decimalprecision"]         # globs relative to the file's folder
inline constexpr const char* CheckConfigName = "quillmark.toml";

struct CheckConfig {
    std::string path;   // of the file
    std::string folder; // absolute, where its globs and ldconfig start
    std::optional<std::vector<std::string>> select, ignore;
    std::optional<FailOn> failOn;
    std::optional<bool> lengthLimit;
    std::optional<std::string> ldconfig; // absolute
    std::vector<std::pair<std::string, std::vector<std::string>>> perFileIgnores;

    // The patterns per-file-ignores gives for the part at partPath (absolute).
    std::vector<std::string> ignoresFor(const std::string& partPath) const;
};

// Reads the config file at path; a wrong one gives the message "path:line: what is wrong".
std::variant<CheckConfig, std::string> ReadCheckConfig(const std::string& path);

// The config of each part: the one named, or the nearest quillmark.toml in the part's folder or
// above, or none. Each folder is looked at once per run. Safe to use from several threads.
class CheckConfigs {
public:
    // named: the --config file (empty: search); search off: --isolated.
    CheckConfigs(std::string named, bool search);

    struct Found {
        const CheckConfig* config = nullptr; // none applies
        const std::string* error = nullptr;  // the config that applies is wrong
        bool firstTold = false;              // the error is told with this part, once per run
    };
    Found forPart(const std::string& partPath);

private:
    using Result = std::variant<CheckConfig, std::string>;
    const Result* read(const std::string& path);
    const Result* nearest(const std::string& folder);

    std::string named_;
    bool search_;
    std::mutex mutex_;
    std::map<std::string, const Result*> byFolder_;
    std::map<std::string, std::unique_ptr<Result>> byFile_;
    std::map<const Result*, bool> told_;
};
