// SPDX-License-Identifier: MIT
#include "CheckConfig.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <fnmatch.h>
#include <sys/stat.h>
#include <toml++/toml.h>
#include <unistd.h>

#include "ClosestWord.h"
#include "ConsoleDialogs.h"
#include "FileDescriptor.h"
#include "Paths.h"

namespace fs = std::filesystem;

namespace {

// A config file is a few lines; anything larger is not one.
constexpr off_t ConfigSizeLimit = 1 << 20;

// The bytes of the regular file at path, or the reason they cannot be read.
std::variant<std::string, std::string> readConfigText(const std::string& path)
{
    const FileDescriptor fd(::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK | O_NOCTTY));
    struct stat status {};
    if (fd.get() < 0 || ::fstat(fd.get(), &status) != 0)
        return std::variant<std::string, std::string>(std::in_place_index<1>, std::strerror(errno));
    if (!S_ISREG(status.st_mode) || status.st_size > ConfigSizeLimit)
        return std::variant<std::string, std::string>(std::in_place_index<1>, "not a config file");
    std::string text(static_cast<std::size_t>(status.st_size), '\0');
    std::size_t done = 0;
    while (done < text.size()) {
        const auto got = ::read(fd.get(), text.data() + done, text.size() - done);
        if (got < 0 && errno == EINTR)
            continue;
        if (got < 0)
            return std::variant<std::string, std::string>(std::in_place_index<1>, std::strerror(errno));
        if (got == 0)
            break;
        done += static_cast<std::size_t>(got);
    }
    text.resize(done);
    return std::variant<std::string, std::string>(std::in_place_index<0>, std::move(text));
}

// A mistake in the config file, at its line.
struct ConfigMistake {
    toml::source_position at;
    std::string what;
};

std::vector<std::string> rulePatterns(const toml::node& node, const char* key)
{
    const auto* list = node.as_array();
    if (list == nullptr)
        throw ConfigMistake{node.source().begin, std::string(key) + " is a list of rule ids"};
    std::vector<std::string> patterns;
    for (const auto& entry : *list) {
        const auto pattern = entry.value<std::string>();
        if (!pattern)
            throw ConfigMistake{entry.source().begin, std::string(key) + " is a list of rule ids"};
        if (const auto unknown = UnknownRulePattern({*pattern}))
            throw ConfigMistake{entry.source().begin, *unknown};
        patterns.push_back(*pattern);
    }
    return patterns;
}

template <typename T>
T valueOf(const toml::node& node, const char* key, const char* kind)
{
    const auto value = node.value<T>();
    if (!value)
        throw ConfigMistake{node.source().begin, std::string(key) + " is " + kind};
    return *value;
}

void readKey(CheckConfig& config, const std::string& key, const toml::node& node)
{
    if (key == "select")
        config.select = rulePatterns(node, "select");
    else if (key == "ignore")
        config.ignore = rulePatterns(node, "ignore");
    else if (key == "fail-on") {
        config.failOn = FailOnNamed(valueOf<std::string>(node, "fail-on", "\"error\", \"warning\" or \"never\""));
        if (!config.failOn)
            throw ConfigMistake{node.source().begin, "fail-on is \"error\", \"warning\" or \"never\""};
    } else if (key == "length-limit")
        config.lengthLimit = valueOf<bool>(node, "length-limit", "true or false");
    else if (key == "ldconfig")
        config.ldconfig =
            (fs::path(config.folder) / valueOf<std::string>(node, "ldconfig", "the path of an LDConfig.ldr"))
                .lexically_normal()
                .string();
    else if (key == "per-file-ignores") {
        const auto* table = node.as_table();
        if (table == nullptr)
            throw ConfigMistake{node.source().begin, "per-file-ignores is a table of globs and rule ids"};
        for (const auto& [glob, ids] : *table)
            config.perFileIgnores.emplace_back(std::string(glob.str()), rulePatterns(ids, "a per-file ignore"));
    } else {
        auto what = "unknown key '" + ShownText(key) + "'";
        if (const auto closest =
                ClosestWord(key, {"select", "ignore", "fail-on", "length-limit", "ldconfig", "per-file-ignores"});
            !closest.empty())
            what += "; did you mean '" + closest + "'?";
        throw ConfigMistake{node.source().begin, what};
    }
}

// Whether glob names the file at relative (a path below the config's folder) or a folder above it.
bool globMatches(const std::string& glob, const std::string& relative)
{
    auto pattern = glob;
    while (pattern.size() > 1 && pattern.ends_with('/'))
        pattern.pop_back();
    if (pattern.find('/') == std::string::npos) {
        // A glob without "/" is about names, in any folder.
        for (std::size_t start = 0; start <= relative.size();) {
            const auto end = std::min(relative.find('/', start), relative.size());
            if (::fnmatch(pattern.c_str(), relative.substr(start, end - start).c_str(), FNM_PERIOD) == 0)
                return true;
            start = end + 1;
        }
        return false;
    }
    for (auto end = relative.find('/');; end = relative.find('/', end + 1)) {
        if (::fnmatch(pattern.c_str(), relative.substr(0, end).c_str(), FNM_PATHNAME | FNM_PERIOD) == 0)
            return true;
        if (end == std::string::npos)
            return false;
    }
}

} // namespace

std::vector<std::string> CheckConfig::ignoresFor(const std::string& partPath) const
{
    std::vector<std::string> patterns;
    const auto relative = fs::path(partPath).lexically_normal().lexically_relative(folder).string();
    if (relative.empty() || relative.starts_with(".."))
        return patterns;
    for (const auto& [glob, ids] : perFileIgnores)
        if (globMatches(glob, relative))
            patterns.insert(patterns.end(), ids.begin(), ids.end());
    return patterns;
}

std::variant<CheckConfig, std::string> ReadCheckConfig(const std::string& path)
{
    using Result = std::variant<CheckConfig, std::string>;
    const auto shown = ShownText(path);
    auto text = readConfigText(path);
    if (text.index() == 1)
        return Result(std::in_place_index<1>, shown + ": cannot read: " + std::get<1>(text));
    CheckConfig config;
    config.path = path;
    config.folder = fs::path(AbsolutePath(path)).lexically_normal().parent_path().string();
    try {
        const auto table = toml::parse(std::get<0>(text), path);
        for (const auto& [key, node] : table)
            readKey(config, std::string(key.str()), node);
    } catch (const toml::parse_error& error) {
        return Result(std::in_place_index<1>, shown + ":" + std::to_string(error.source().begin.line) + ": " +
                                                  std::string(error.description()));
    } catch (const ConfigMistake& mistake) {
        return Result(std::in_place_index<1>, shown + ":" + std::to_string(mistake.at.line) + ": " + mistake.what);
    }
    return Result(std::in_place_index<0>, std::move(config));
}

CheckConfigs::CheckConfigs(std::string named, bool search) : named_(std::move(named)), search_(search) {}

const CheckConfigs::Result* CheckConfigs::read(const std::string& path)
{
    auto& result = byFile_[path];
    if (!result)
        result = std::make_unique<Result>(ReadCheckConfig(path));
    return result.get();
}

const CheckConfigs::Result* CheckConfigs::nearest(const std::string& folder)
{
    if (const auto known = byFolder_.find(folder); known != byFolder_.end())
        return known->second;
    const Result* found = nullptr;
    const auto candidate = (fs::path(folder) / CheckConfigName).string();
    struct stat status {};
    if (::stat(candidate.c_str(), &status) == 0 && S_ISREG(status.st_mode))
        found = read(candidate);
    else if (const auto parent = fs::path(folder).parent_path().string(); parent != folder)
        found = nearest(parent);
    byFolder_[folder] = found;
    return found;
}

CheckConfigs::Found CheckConfigs::forPart(const std::string& partPath)
{
    const std::lock_guard lock(mutex_);
    const Result* result = nullptr;
    if (!named_.empty())
        result = read(named_);
    else if (search_)
        result = nearest(fs::path(partPath).parent_path().string());
    if (result == nullptr)
        return {};
    if (result->index() == 0)
        return {&std::get<0>(*result)};
    auto& told = told_[result];
    const bool first = !told;
    told = true;
    return {nullptr, &std::get<1>(*result), first};
}
