#include "Preferences.h"

#include "SettingsStore.h"
#include "Text.h"

namespace {

// A stored text, or empty when it is blank after trimming.
std::string storedText(const SettingsStore& store, const char* key)
{
    auto value = store.read(DefaultGroup, key, "");
    return TrimBlanks(value).empty() ? std::string() : value;
}

} // namespace

void LadeDefaults(Preferences& preferences, const SettingsStore& store)
{
    preferences.DefaultRealName = storedText(store, "RealName");
    preferences.DefaultUserName = storedText(store, "UserName");
    preferences.DefaultLicense = storedText(store, "Liscense");
}

bool StoredBackupChoice(const SettingsStore& store)
{
    const auto value = store.read(DefaultGroup, "Backup", "True");
    const auto trimmed = TrimBlanks(value);
    return trimmed == "True" || trimmed == "Wahr";
}

PreferencesForm OpenPreferencesForm(Preferences& preferences, const SettingsStore& store)
{
    PreferencesForm form{storedText(store, "RealName"), storedText(store, "UserName"), storedText(store, "Liscense"),
                         StoredBackupChoice(store)};
    if (!form.license.empty())
        preferences.DefaultLicense = form.license;
    preferences.MakeBackup = form.backup;
    return form;
}

void SavePreferencesForm(const PreferencesForm& form, Preferences& preferences, SettingsStore& store)
{
    store.write(DefaultGroup, "RealName", std::string(TrimBlanks(form.realName)));
    store.write(DefaultGroup, "UserName", std::string(TrimBlanks(form.userName)));
    store.write(DefaultGroup, "Liscense", std::string(TrimBlanks(form.license)));
    store.write(DefaultGroup, "Backup", form.backup ? "True" : "False");
    preferences.MakeBackup = form.backup;
}

std::string StartFolder(const SettingsStore& store, const std::string& programFolder)
{
    return store.read(DefaultGroup, "LastPath", programFolder);
}

void StoreLastPath(SettingsStore& store, const std::string& folder) { store.write(DefaultGroup, "LastPath", folder); }
