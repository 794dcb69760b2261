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

// A stored choice: "True" or "Wahr" after trimming means on, a missing key too.
bool storedChoice(const SettingsStore& store, const char* key)
{
    const auto value = store.read(DefaultGroup, key, "True");
    const auto trimmed = TrimBlanks(value);
    return trimmed == "True" || trimmed == "Wahr";
}

const char* choiceText(bool on) { return on ? "True" : "False"; }

} // namespace

void LadeDefaults(Preferences& preferences, const SettingsStore& store)
{
    preferences.DefaultRealName = storedText(store, "RealName");
    preferences.DefaultUserName = storedText(store, "UserName");
    preferences.DefaultLicense = storedText(store, "Liscense");
}

bool StoredBackupChoice(const SettingsStore& store) { return storedChoice(store, "Backup"); }

bool StoredDescriptionLimit(const SettingsStore& store) { return storedChoice(store, "DescriptionLimit"); }

PreferencesForm OpenPreferencesForm(Preferences& preferences, const SettingsStore& store)
{
    PreferencesForm form{storedText(store, "RealName"), storedText(store, "UserName"), storedText(store, "Liscense"),
                         StoredBackupChoice(store), StoredDescriptionLimit(store)};
    if (!form.license.empty())
        preferences.DefaultLicense = form.license;
    preferences.MakeBackup = form.backup;
    preferences.LimitDescription = form.descriptionLimit;
    return form;
}

void SavePreferencesForm(const PreferencesForm& form, Preferences& preferences, SettingsStore& store)
{
    store.write(DefaultGroup, "RealName", std::string(TrimBlanks(form.realName)));
    store.write(DefaultGroup, "UserName", std::string(TrimBlanks(form.userName)));
    store.write(DefaultGroup, "Liscense", std::string(TrimBlanks(form.license)));
    store.write(DefaultGroup, "Backup", choiceText(form.backup));
    store.write(DefaultGroup, "DescriptionLimit", choiceText(form.descriptionLimit));
    preferences.MakeBackup = form.backup;
    preferences.LimitDescription = form.descriptionLimit;
}

std::string StartFolder(const SettingsStore& store, const std::string& firstFolder)
{
    return store.read(DefaultGroup, "LastPath", firstFolder);
}

void StoreLastPath(SettingsStore& store, const std::string& folder) { store.write(DefaultGroup, "LastPath", folder); }
