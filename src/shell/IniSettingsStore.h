// SPDX-License-Identifier: MIT
#pragma once

#include <memory>

#include "SettingsStore.h"

class QSettings;

// The settings in an INI file: by default the user's own (organisation and application
// "Quillmark"), or any file given, which is how tests keep away from the user's settings.
class IniSettingsStore : public SettingsStore {
public:
    IniSettingsStore();
    explicit IniSettingsStore(const std::string& iniFile);
    ~IniSettingsStore() override;

    std::optional<std::string> read(const std::string& group, const std::string& key) const override;
    void write(const std::string& group, const std::string& key, const std::string& value) override;
    std::vector<std::pair<std::string, std::string>> readGroup(const std::string& group) const override;
    using SettingsStore::read;

private:
    std::unique_ptr<QSettings> settings_;
};
