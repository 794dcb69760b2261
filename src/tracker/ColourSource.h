// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <map>
#include <memory>
#include <mutex>
#include <string>

#include "ColourCodes.h"

// Where a part's colour codes come from: the LDConfig.ldr given, else the first one found in the
// part's folder or above it (a library keeps it beside parts/ and p/), else the built-in list.
// An LDConfig.ldr that cannot be read or defines no colour is reported once and the built-in
// list used in its place. Safe to use from several threads.
class ColourSource {
public:
    using Report = std::function<void(const std::string&)>;
    // givenLDConfig: empty to search above each part; report tells of a given file that is unusable.
    ColourSource(ColourCodes builtIn, const std::string& givenLDConfig, const Report& report);

    // report tells of an LDConfig.ldr found for this part that is unusable and was not told before.
    const ColourCodes& forPart(const std::string& partPath, const Report& report);
    // The codes of the LDConfig.ldr at path, read once.
    const ColourCodes& ofLDConfig(const std::string& path, const Report& report);

private:
    const ColourCodes& readLDConfig(const std::string& path, const Report& report);

    ColourCodes builtIn_;
    const ColourCodes* given_ = nullptr;
    std::mutex mutex_;
    std::map<std::string, const ColourCodes*> byFolder_;
    std::map<std::string, std::unique_ptr<ColourCodes>> byFile_;
};

// The data file of the built-in list, which ships beside the list files.
inline constexpr const char* BuiltInColoursFile = "colourcodes.txt";

// The built-in list from its data file. Throws QmError when the file cannot be read or holds no
// list of codes.
ColourCodes ReadBuiltInColours(const std::string& path);
