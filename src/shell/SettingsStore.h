// SPDX-License-Identifier: MIT
#pragma once

#include <iterator>
#include <optional>
#include <string>
#include <utility>
#include <vector>

// The per-user settings: text values by group and key. Texts are UTF-8.
class SettingsStore {
public:
    virtual ~SettingsStore() = default;
    virtual std::optional<std::string> read(const std::string& group, const std::string& key) const = 0;
    virtual void write(const std::string& group, const std::string& key, const std::string& value) = 0;
    // Every key and value of a group, in the store's order.
    virtual std::vector<std::pair<std::string, std::string>> readGroup(const std::string& group) const = 0;

    std::string read(const std::string& group, const std::string& key, const std::string& defaultValue) const
    {
        return read(group, key).value_or(defaultValue);
    }
};

inline constexpr const char* DefaultGroup = "DEFAULT";
inline constexpr const char* RecentFilesGroup = "Recent Files";

// The settings of the "DEFAULT" group.
enum class Setting { RealName, UserName, License, Backup, DescriptionLimit, LastPath };
inline constexpr Setting AllSettings[] = {Setting::RealName, Setting::UserName,         Setting::License,
                                          Setting::Backup,   Setting::DescriptionLimit, Setting::LastPath};

// The names the settings file has always used for them ("Liscense" included: stored files rely on it).
constexpr const char* SettingName(Setting setting)
{
    constexpr const char* names[] = {"RealName", "UserName", "Liscense", "Backup", "DescriptionLimit", "LastPath"};
    static_assert(std::size(names) == std::size(AllSettings), "one name for each setting");
    return names[static_cast<int>(setting)];
}
