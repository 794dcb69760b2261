// SPDX-License-Identifier: MIT
#pragma once

#include <optional>
#include <string>
#include <vector>

#include "CheckConfig.h"
#include "RuleChoice.h"

// What the command line says of check's settings; each one given stands over the config file's.
struct CommandLineSettings {
    std::optional<std::vector<std::string>> select, ignore;
    std::optional<FailOn> failOn;
    bool noLengthLimit = false;
    std::string ldconfig;
};

// The settings check works on one part with.
struct PartSettings {
    RuleChoice choice;
    bool limitDescription = true;
    std::string ldconfig; // empty: the first LDConfig.ldr above the part, else the built-in list
};

// partPath absolute; config the one that applies to it, if any.
PartSettings SettingsForPart(const CommandLineSettings& given, const CheckConfig* config, const std::string& partPath);
