// SPDX-License-Identifier: MIT
#include "PartSettings.h"

PartSettings SettingsForPart(const CommandLineSettings& given, const CheckConfig* config, const std::string& partPath)
{
    const CheckConfig none;
    const auto& from = config != nullptr ? *config : none;
    PartSettings settings;
    settings.choice.select = given.select.value_or(from.select.value_or(std::vector<std::string>{}));
    settings.choice.ignore = given.ignore.value_or(from.ignore.value_or(std::vector<std::string>{}));
    const auto perFile = from.ignoresFor(partPath);
    settings.choice.ignore.insert(settings.choice.ignore.end(), perFile.begin(), perFile.end());
    settings.choice.failOn = given.failOn.value_or(from.failOn.value_or(FailOn::Error));
    settings.limitDescription = !given.noLengthLimit && from.lengthLimit.value_or(true);
    settings.ldconfig = !given.ldconfig.empty() ? given.ldconfig : from.ldconfig.value_or(std::string());
    return settings;
}
