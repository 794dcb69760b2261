#include <gtest/gtest.h>

#include "IniSettingsStore.h"
#include "Preferences.h"
#include "TempDir.h"

namespace {

class PreferencesStore : public ::testing::Test {
protected:
    TempDir dir;
    IniSettingsStore store{dir.file("Quillmark.ini")};
    Preferences preferences;
};

TEST_F(PreferencesStore, BackupIsOnOnlyForTrueOrWahr)
{
    const std::pair<const char*, bool> cases[] = {{"True", true}, {" True ", true}, {"Wahr", true},
                                                  {"true", false}, {"False", false}, {"", false}};
    for (const auto& [stored, on] : cases) {
        store.write(DefaultGroup, "Backup", stored);
        EXPECT_EQ(StoredBackupChoice(store), on) << stored;
        preferences.MakeBackup = !on;
        OpenPreferencesForm(preferences, store);
        EXPECT_EQ(preferences.MakeBackup, on) << "applied on opening, even when cancelled";
    }
}

TEST_F(PreferencesStore, SavingTrimsTheTexts)
{
    SavePreferencesForm({"  Jane Doe ", " jdoe", "L ", false}, preferences, store);
    EXPECT_EQ(store.read(DefaultGroup, "RealName", ""), "Jane Doe");
    EXPECT_EQ(store.read(DefaultGroup, "UserName", ""), "jdoe");
    EXPECT_EQ(store.read(DefaultGroup, "Liscense", ""), "L");
    EXPECT_EQ(store.read(DefaultGroup, "Backup", ""), "False");
    EXPECT_FALSE(preferences.MakeBackup);
}

TEST_F(PreferencesStore, LadeDefaultsTakesTheStoredValuesAndBlankAsEmpty)
{
    store.write(DefaultGroup, "RealName", "Jane");
    store.write(DefaultGroup, "UserName", "   ");
    store.write(DefaultGroup, "Liscense", "L");
    LadeDefaults(preferences, store);
    EXPECT_EQ(preferences.DefaultRealName, "Jane");
    EXPECT_EQ(preferences.DefaultUserName, "");
    EXPECT_EQ(preferences.DefaultLicense, "L");
    SavePreferencesForm({"", "", "", true}, preferences, store);
    LadeDefaults(preferences, store);
    EXPECT_EQ(preferences.DefaultRealName, "") << "a name cleared in the preferences is gone";
}

TEST_F(PreferencesStore, StoredLicenceBecomesTheDefaultWhenTheWindowOpens)
{
    store.write(DefaultGroup, "Liscense", "Not in any list");
    const auto form = OpenPreferencesForm(preferences, store);
    EXPECT_EQ(form.license, "Not in any list");
    EXPECT_EQ(preferences.DefaultLicense, "Not in any list");
}

TEST_F(PreferencesStore, LastPathOrTheProgramFolder)
{
    EXPECT_EQ(StartFolder(store, "/opt/quillmark"), "/opt/quillmark");
    StoreLastPath(store, "/home/ann/parts");
    EXPECT_EQ(StartFolder(store, "/opt/quillmark"), "/home/ann/parts");
    IniSettingsStore reopened(dir.file("Quillmark.ini"));
    EXPECT_EQ(StartFolder(reopened, "/x"), "/home/ann/parts");
}

} // namespace
