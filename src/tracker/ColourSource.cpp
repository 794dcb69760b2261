// SPDX-License-Identifier: MIT
#include "ColourSource.h"

#include <filesystem>

#include "PartFile.h"
#include "QmError.h"

namespace fs = std::filesystem;

namespace {
constexpr const char* LDConfigName = "LDConfig.ldr";
} // namespace

ColourSource::ColourSource(ColourCodes builtIn, const std::string& givenLDConfig, const Report& report)
    : builtIn_(std::move(builtIn))
{
    if (!givenLDConfig.empty())
        given_ = &readLDConfig(givenLDConfig, report);
}

const ColourCodes& ColourSource::forPart(const std::string& partPath, const Report& report)
{
    if (given_ != nullptr)
        return *given_;
    if (partPath.empty()) // a file never saved has no folder to search
        return builtIn_;
    const std::lock_guard lock(mutex_);
    std::error_code error;
    auto folder = fs::absolute(partPath, error).parent_path();
    std::vector<std::string> passed;
    const ColourCodes* found = &builtIn_;
    for (;; folder = folder.parent_path()) {
        if (const auto known = byFolder_.find(folder.string()); known != byFolder_.end()) {
            found = known->second;
            break;
        }
        passed.push_back(folder.string());
        if (const auto candidate = folder / LDConfigName; fs::is_regular_file(candidate, error)) {
            found = &readLDConfig(candidate.string(), report);
            break;
        }
        if (folder == folder.parent_path() || folder.empty())
            break;
    }
    for (const auto& name : passed)
        byFolder_[name] = found;
    return *found;
}

const ColourCodes& ColourSource::ofLDConfig(const std::string& path, const Report& report)
{
    const std::lock_guard lock(mutex_);
    return readLDConfig(path, report);
}

const ColourCodes& ColourSource::readLDConfig(const std::string& path, const Report& report)
{
    auto& codes = byFile_[path];
    if (codes)
        return *codes;
    try {
        const FileBytes bytes(path);
        if (auto read = ReadLDConfig(bytes.view()))
            codes = std::make_unique<ColourCodes>(std::move(*read));
        else
            report(path + " defines no colour in the shape the Parts Tracker reads; the built-in colour list is "
                          "used instead.");
    } catch (const QmError& failure) {
        report("Cannot read " + path + " (" + failure.description() + "); the built-in colour list is used instead.");
    }
    if (!codes)
        codes = std::make_unique<ColourCodes>(builtIn_);
    return *codes;
}

ColourCodes ReadBuiltInColours(const std::string& path)
{
    const FileBytes bytes(path);
    auto codes = ReadColourRanges(bytes.view());
    if (!codes)
        throw QmError(ErrorNumber::InputPastEndOfFile, path + " holds no list of colour codes");
    return std::move(*codes);
}
