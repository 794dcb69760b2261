// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <fstream>
#include <iterator>
#include <string>
#include <sys/stat.h>

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

TEST_F(PreferencesStore, ChoicesAreOnWhenMissingAndOnlyForTrueOrWahr)
{
    EXPECT_TRUE(StoredBackupChoice(store));
    EXPECT_TRUE(StoredDescriptionLimit(store));
    const std::pair<const char*, bool> cases[] = {{"True", true},  {" True ", true}, {"Wahr", true},
                                                  {"true", false}, {"False", false}, {"", false}};
    for (const auto& [stored, on] : cases) {
        store.write(DefaultGroup, "Backup", stored);
        store.write(DefaultGroup, "DescriptionLimit", stored);
        EXPECT_EQ(StoredBackupChoice(store), on) << stored;
        EXPECT_EQ(StoredDescriptionLimit(store), on) << stored;
        preferences.MakeBackup = preferences.LimitDescription = !on;
        OpenPreferencesForm(preferences, store);
        EXPECT_EQ(preferences.MakeBackup, on) << "applied on opening, even when cancelled";
        EXPECT_EQ(preferences.LimitDescription, on);
    }
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
    SavePreferencesForm({"", " jtester ", "  Licensed under CC BY 4.0 : see CAreadme.txt ", true}, preferences, store);
    EXPECT_EQ(preferences.DefaultRealName, "") << "a name cleared in the preferences is gone";
    EXPECT_EQ(preferences.DefaultUserName, "jtester") << "taken at once";
    EXPECT_EQ(store.read(DefaultGroup, "Liscense", ""), "Licensed under CC BY 4.0 : see CAreadme.txt");
}

TEST_F(PreferencesStore, LastPathOrTheProgramFolder)
{
    EXPECT_EQ(StartFolder(store, "/opt/quillmark"), "/opt/quillmark");
    StoreLastPath(store, "/home/ann/parts");
    EXPECT_EQ(StartFolder(store, "/opt/quillmark"), "/home/ann/parts");
    IniSettingsStore reopened(dir.file("Quillmark.ini"));
    EXPECT_EQ(StartFolder(reopened, "/x"), "/home/ann/parts");
}

// Opening file after file in one folder stores the same folder each time: the settings file is
// rewritten only for a new value, and a value another instance of the program stored meanwhile
// still gives way to this one.
TEST_F(PreferencesStore, OnlyANewValueRewritesTheSettingsFile)
{
    const auto inode = [this]() {
        struct stat info {};
        EXPECT_EQ(::stat(dir.file("Quillmark.ini").c_str(), &info), 0);
        return info.st_ino;
    };
    StoreLastPath(store, "/parts");
    const auto written = inode();
    StoreLastPath(store, "/parts");
    EXPECT_EQ(inode(), written);
    std::ifstream stored(dir.file("Quillmark.ini"));
    std::string text((std::istreambuf_iterator<char>(stored)), std::istreambuf_iterator<char>());
    text.replace(text.find("/parts"), 6, "/p"); // as another instance would write it
    std::ofstream(dir.file("Quillmark.ini"), std::ios::trunc) << text;
    StoreLastPath(store, "/parts");
    EXPECT_EQ(IniSettingsStore{dir.file("Quillmark.ini")}.read(DefaultGroup, "LastPath"), "/parts");
}

} // namespace
