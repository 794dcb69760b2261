// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>
#include <sys/stat.h>

#include "ListFolder.h"
#include "TempDir.h"

namespace fs = std::filesystem;

namespace {

const char* const Lists[] = {"category.txt", "parttype.txt", "bfc.txt", "licenses.txt"};

class ListFolders : public ::testing::Test {
protected:
    ListFolders()
    {
        for (const auto* folder : {"bin", "defaults", "user"})
            fs::create_directory(dir.path() / folder);
        for (const auto* list : Lists)
            TempDir::writeTo(defaults + "/" + list, std::string("default ") + list);
    }
    TempDir dir;
    const std::string bin = dir.file("bin"), defaults = dir.file("defaults"), user = dir.file("user/Quillmark");
};

TEST_F(ListFolders, ListsBesideTheProgramAreUsedThere)
{
    for (const auto* list : Lists)
        TempDir::writeTo(bin + "/" + list, "mine");
    EXPECT_EQ(ListFolderFor(bin, user, defaults), bin);
    EXPECT_FALSE(fs::exists(user));
}

TEST_F(ListFolders, OtherwiseTheUsersCopiesAreMadeOnceFromTheDefaults)
{
    TempDir::writeTo(bin + "/category.txt", "only one beside the program");
    EXPECT_EQ(ListFolderFor(bin, user, defaults), user);
    EXPECT_EQ(ReadBytes(user + "/bfc.txt"), "default bfc.txt");
    TempDir::writeTo(user + "/bfc.txt", "edited by the user");
    fs::remove(user + "/licenses.txt");
    EXPECT_EQ(ListFolderFor(bin, user, defaults), user);
    EXPECT_EQ(ReadBytes(user + "/bfc.txt"), "edited by the user");
    EXPECT_EQ(ReadBytes(user + "/licenses.txt"), "default licenses.txt");
    EXPECT_EQ(ReadBytes(defaults + "/bfc.txt"), "default bfc.txt");
}

TEST_F(ListFolders, AnUneditedCopyFollowsAChangedDefaultAndAnEditedOneIsKept)
{
    ListFolderFor(bin, user, defaults);
    TempDir::writeTo(user + "/bfc.txt", "edited by the user");
    TempDir::writeTo(defaults + "/bfc.txt", "upgraded bfc.txt");
    TempDir::writeTo(defaults + "/licenses.txt", "upgraded licenses.txt");
    ListFolderFor(bin, user, defaults);
    EXPECT_EQ(ReadBytes(user + "/bfc.txt"), "edited by the user");
    EXPECT_EQ(ReadBytes(user + "/licenses.txt"), "upgraded licenses.txt");
    EXPECT_EQ(ReadBytes(user + "/category.txt"), "default category.txt");
    TempDir::writeTo(defaults + "/bfc.txt", "upgraded again");
    ListFolderFor(bin, user, defaults);
    EXPECT_EQ(ReadBytes(user + "/bfc.txt"), "edited by the user");
}

TEST_F(ListFolders, CopiesOfReadOnlyDefaultsTakeTheUsersModeForNewFiles)
{
    for (const auto* list : Lists)
        fs::permissions(defaults + "/" + list, fs::perms(0444));
    const auto oldMask = ::umask(002);
    ListFolderFor(bin, user, defaults);
    ::umask(oldMask);
    for (const auto* list : Lists)
        EXPECT_EQ(fs::status(user + "/" + list).permissions(), fs::perms(0664)) << list;
}

TEST_F(ListFolders, WithoutDefaultsNothingIsCopiedAndLoadingReportsTheMissingList)
{
    EXPECT_EQ(ListFolderFor(bin, user, dir.file("none")), user);
    EXPECT_TRUE(fs::is_empty(user));
}

} // namespace
