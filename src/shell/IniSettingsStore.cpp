// SPDX-License-Identifier: MIT
#include "IniSettingsStore.h"

#include <QSettings>

namespace {

QString text(const std::string& utf8) { return QString::fromStdString(utf8); }

// QSettings treats "General" as the keys outside any group; every group here is an ordinary one.
QString key(const std::string& group, const std::string& name) { return text(group) + "/" + text(name); }

} // namespace

IniSettingsStore::IniSettingsStore()
    : settings_(std::make_unique<QSettings>(QSettings::IniFormat, QSettings::UserScope, "Quillmark", "Quillmark"))
{
}

IniSettingsStore::IniSettingsStore(const std::string& iniFile)
    : settings_(std::make_unique<QSettings>(text(iniFile), QSettings::IniFormat))
{
}

IniSettingsStore::~IniSettingsStore() = default;

std::optional<std::string> IniSettingsStore::read(const std::string& group, const std::string& name) const
{
    const auto value = settings_->value(key(group, name));
    if (!value.isValid())
        return std::nullopt;
    return value.toString().toStdString();
}

// A value stored already is not written again: opening one file after another in the same folder
// would otherwise rewrite the settings file, and wait for the disk, at every open.
void IniSettingsStore::write(const std::string& group, const std::string& name, const std::string& value)
{
    settings_->sync(); // takes in what another instance of the program wrote meanwhile
    if (read(group, name) == value)
        return;
    settings_->setValue(key(group, name), text(value));
    settings_->sync();
}

std::vector<std::pair<std::string, std::string>> IniSettingsStore::readGroup(const std::string& group) const
{
    std::vector<std::pair<std::string, std::string>> pairs;
    settings_->beginGroup(text(group));
    for (const auto& name : settings_->childKeys())
        pairs.emplace_back(name.toStdString(), settings_->value(name).toString().toStdString());
    settings_->endGroup();
    return pairs;
}
