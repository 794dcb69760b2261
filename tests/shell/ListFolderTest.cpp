#include <gtest/gtest.h>

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

TEST_F(ListFolders, WithoutDefaultsNothingIsCopiedAndLoadingReportsTheMissingList)
{
    EXPECT_EQ(ListFolderFor(bin, user, dir.file("none")), user);
    EXPECT_TRUE(fs::is_empty(user));
}

} // namespace
