// SPDX-License-Identifier: MIT
#include "Preferences.h"

#include <QCoreApplication>

#include "SettingsStore.h"
#include "Text.h"

namespace {

// A stored text, or empty when it is blank after trimming.
std::string storedText(const SettingsStore& store, Setting setting)
{
    auto value = store.read(DefaultGroup, SettingName(setting), "");
    return TrimBlanks(value).empty() ? std::string() : value;
}

// A stored choice: "True" or "Wahr" after trimming means on, a missing key too.
bool storedChoice(const SettingsStore& store, Setting setting)
{
    const auto value = store.read(DefaultGroup, SettingName(setting), "True");
    const auto trimmed = TrimBlanks(value);
    return trimmed == "True" || trimmed == "Wahr";
}

const char* choiceText(bool on) { return on ? "True" : "False"; }

} // namespace

void LadeDefaults(Preferences& preferences, const SettingsStore& store)
{
    preferences.DefaultRealName = storedText(store, Setting::RealName);
    preferences.DefaultUserName = storedText(store, Setting::UserName);
    preferences.DefaultLicense = storedText(store, Setting::License);
}

bool PreferencesHoldNoName(const SettingsStore& store)
{
    return storedText(store, Setting::RealName).empty() && storedText(store, Setting::UserName).empty();
}

bool StoredBackupChoice(const SettingsStore& store) { return storedChoice(store, Setting::Backup); }

bool StoredDescriptionLimit(const SettingsStore& store) { return storedChoice(store, Setting::DescriptionLimit); }

PreferencesForm OpenPreferencesForm(Preferences& preferences, const SettingsStore& store)
{
    PreferencesForm form{storedText(store, Setting::RealName), storedText(store, Setting::UserName),
                         storedText(store, Setting::License), StoredBackupChoice(store), StoredDescriptionLimit(store)};
    if (!form.license.empty())
        preferences.DefaultLicense = form.license;
    preferences.MakeBackup = form.backup;
    preferences.LimitDescription = form.descriptionLimit;
    return form;
}

std::string PreferencesFormRefusal(const PreferencesForm& form)
{
    const auto tr = [](const char* text) { return QCoreApplication::translate("Preferences", text).toStdString(); };
    if (TrimBlanks(form.realName).empty())
        return tr("Enter your real name: it goes into the Author line of the parts you save.");
    if (TrimBlanks(form.userName).empty())
        return tr("Enter your username: it goes into the Author line and into new History lines.");
    return {};
}

void SavePreferencesForm(const PreferencesForm& form, Preferences& preferences, SettingsStore& store)
{
    store.write(DefaultGroup, SettingName(Setting::RealName), std::string(TrimBlanks(form.realName)));
    store.write(DefaultGroup, SettingName(Setting::UserName), std::string(TrimBlanks(form.userName)));
    store.write(DefaultGroup, SettingName(Setting::License), std::string(TrimBlanks(form.license)));
    store.write(DefaultGroup, SettingName(Setting::Backup), choiceText(form.backup));
    store.write(DefaultGroup, SettingName(Setting::DescriptionLimit), choiceText(form.descriptionLimit));
    preferences.MakeBackup = form.backup;
    preferences.LimitDescription = form.descriptionLimit;
    LadeDefaults(preferences, store); // what the History stub and Set Preferences offer from now on
}

std::string StartFolder(const SettingsStore& store, const std::string& firstFolder)
{
    return store.read(DefaultGroup, SettingName(Setting::LastPath), firstFolder);
}

void StoreLastPath(SettingsStore& store, const std::string& folder)
{
    store.write(DefaultGroup, SettingName(Setting::LastPath), folder);
}
