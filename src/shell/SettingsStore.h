#pragma once

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
