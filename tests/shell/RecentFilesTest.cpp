// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "IniSettingsStore.h"
#include "RecentFiles.h"
#include "TempDir.h"

namespace {

class RecentFiles : public ::testing::Test {
protected:
    std::vector<std::string> shown() const
    {
        std::vector<std::string> captions;
        for (std::size_t i = 1; i < menu.MRecentFile.size(); ++i)
            if (menu.MRecentFile[i].visible)
                captions.push_back(menu.MRecentFile[i].caption);
        return captions;
    }
    TempDir dir;
    IniSettingsStore store{dir.file("Quillmark.ini")};
    RecentFilesMenu menu;
};

TEST_F(RecentFiles, NewestFirstAndAReopenedFileKeepsItsPlace)
{
    for (const auto* path : {"/p/a.dat", "/p/b.dat", "/p/c.dat", "/p/b.dat"})
        AddRecentFile(menu, store, path);
    EXPECT_TRUE(menu.MRecentFile[0].visible);
    EXPECT_EQ(shown(), (std::vector<std::string>{"/p/c.dat", "/p/b.dat", "/p/a.dat"}));
    EXPECT_EQ(store.read(RecentFilesGroup, "RecentFile1", ""), "/p/c.dat");
    EXPECT_EQ(store.read(RecentFilesGroup, "RecentFile3", ""), "/p/a.dat");
    AddRecentFile(menu, store, "");
    EXPECT_EQ(shown().size(), 3u);
}

TEST_F(RecentFiles, TenFilesKeepTheNineNewest)
{
    for (int i = 1; i <= 10; ++i)
        AddRecentFile(menu, store, "/p/" + std::to_string(i) + ".dat");
    const auto captions = shown();
    ASSERT_EQ(captions.size(), 9u);
    EXPECT_EQ(captions.front(), "/p/10.dat");
    EXPECT_EQ(captions.back(), "/p/2.dat");
    EXPECT_FALSE(IsRecentFile(menu, "/p/1.dat"));
    EXPECT_FALSE(store.read(RecentFilesGroup, "RecentFile10").has_value());
    AddRecentFile(menu, store, "/p/2.dat"); // the ninth, opened again, keeps its place
    EXPECT_EQ(shown(), captions);
}

TEST_F(RecentFiles, DifferentlyWrittenPathsAreDifferentEntries)
{
    AddRecentFile(menu, store, "/p/a.dat");
    AddRecentFile(menu, store, "/p/A.dat");
    AddRecentFile(menu, store, "/p/./a.dat");
    EXPECT_EQ(shown().size(), 3u);
}

} // namespace
