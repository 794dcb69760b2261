// SPDX-License-Identifier: MIT
#pragma once

#include <string>

class SettingsStore;

// The author's own defaults, kept beside the record for the run.
struct Preferences {
    std::string DefaultRealName;
    std::string DefaultUserName;
    std::string DefaultLicense;
    bool MakeBackup = true;
    bool LimitDescription = true; // the description's 64 characters
};

// Refreshes the three default texts from the store; a value that is blank after trimming is empty.
void LadeDefaults(Preferences& preferences, const SettingsStore& store);

// True while the store holds neither a real name nor a user name (blank ones count as none).
bool PreferencesHoldNoName(const SettingsStore& store);

// The stored "Backup" choice: "True" or "Wahr" after trimming means on, a missing key too.
bool StoredBackupChoice(const SettingsStore& store);
// The stored "DescriptionLimit" choice, read as "Backup" is.
bool StoredDescriptionLimit(const SettingsStore& store);

// What the preferences window shows and saves.
struct PreferencesForm {
    std::string realName;
    std::string userName;
    std::string license; // the stored licence; the window selects the last entry equal to it
    bool backup = true;
    bool descriptionLimit = true;
};

// Opening the window: the stored values (blank ones shown empty), and at once the stored backup
// and description-limit choices into MakeBackup and LimitDescription and a stored licence into
// DefaultLicense.
PreferencesForm OpenPreferencesForm(Preferences& preferences, const SettingsStore& store);

// Why the window's values cannot be saved ("" when they can): a real name and a user name are
// needed, as the parts' author line and history lines name them.
std::string PreferencesFormRefusal(const PreferencesForm& form);

// Saving the window: the texts trimmed, "Backup" and "DescriptionLimit" as "True" or "False";
// preferences takes every value saved.
void SavePreferencesForm(const PreferencesForm& form, Preferences& preferences, SettingsStore& store);

// The folder the Open dialog starts in: "LastPath", or firstFolder on the first run.
std::string StartFolder(const SettingsStore& store, const std::string& firstFolder);
void StoreLastPath(SettingsStore& store, const std::string& folder);
