// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "Paths.h"
#include "ScriptedDialogs.h"

namespace {

TEST(PathHelpers, NameAndFolder)
{
    ScriptedDialogs dialogs;
    EXPECT_EQ(DateiNurName("/home/ann/parts/3001.dat", dialogs), "3001.dat");
    EXPECT_EQ(DateiNurName("  3001.dat ", dialogs), "3001.dat");
    EXPECT_EQ(DateiNurName("parts/", dialogs), "");
    EXPECT_EQ(DateiNurName("a\\b.dat", dialogs), "a\\b.dat");
    EXPECT_EQ(DateiNurPfad("/home/ann/parts/3001.dat"), "/home/ann/parts");
    EXPECT_EQ(DateiNurPfad("/3001.dat"), "/");
    EXPECT_EQ(DateiNurPfad("3001.dat"), "");
    EXPECT_EQ(DateiNurPfad("parts/s/3001s01.dat"), "parts/s");
    EXPECT_TRUE(dialogs.messages.empty());
}

} // namespace
