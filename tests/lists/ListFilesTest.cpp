// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "QmError.h"
#include "ScriptedDialogs.h"
#include "StandardLists.h"
#include "TempDir.h"

namespace {

TEST(ListFiles, OneEntryPerLineExactlyAsRead)
{
    TempDir dir;
    EXPECT_EQ(ReadListFile(dir.write("a.txt", "Brick\r\n  Plate\r\n\r\n")), (StringList{"Brick", "  Plate", ""}));
    EXPECT_EQ(ReadListFile(dir.write("b.txt", "x\ry\r\nz")), (StringList{"x", "y", "z"}));
    EXPECT_EQ(ReadListFile(dir.write("c.txt", "x\ny\n")), (StringList{"x\ny\n"}));
    EXPECT_EQ(ReadListFile(dir.write("d.txt", "x\r\nx\r\n")), (StringList{"x", "x"}));
    EXPECT_EQ(ReadListFile(dir.write("e.txt", "")), StringList{});
    EXPECT_EQ(ReadListFile(dir.write("f.txt", std::string(ListFileLimit, 'x'))).size(), 1u);
}

TEST(ListFiles, MissingOrHugeFileIsReportedAndGivesAnEmptyList)
{
    TempDir dir;
    dir.write("category.txt", "Brick\r\n");
    const auto huge = dir.write("parttype.txt", std::string(ListFileLimit + 1, '\n'));
    ScriptedDialogs dialogs;
    for (int i = 0; i < 3; ++i)
        dialogs.expectMessage(Answer::Ok);
    StandardLists lists;
    LoadStandardLists(lists, dir.path().string(), dialogs);
    EXPECT_TRUE(lists.PartTypes.empty());
    EXPECT_EQ(EntriesOf(lists, ListKind::Category), StringList{"Brick"});
    ASSERT_EQ(dialogs.messages.size(), 3u);
    EXPECT_EQ(dialogs.messages[0].text, "Error 75 (The list file " + huge +
                                            " is larger than 1 MB) in procedure LoadPartTypes of Modul modCategory");
    EXPECT_EQ(dialogs.messages[1].text, "Error 53 (File not found) in procedure LoadBFC of Modul modCategory\r\n" +
                                            (dir.path() / "bfc.txt").string() + ": No such file or directory");
}

TEST(ListFiles, WriterPutsCrLfAfterEveryEntry)
{
    TempDir dir;
    const auto path = dir.file("bfc.txt");
    WriteListFile(path, {"A", "", "  b"});
    EXPECT_EQ(ReadBytes(path), "A\r\n\r\n  b\r\n");
    WriteListFile(path, {});
    EXPECT_EQ(ReadBytes(path), "");
}

// What a killed list save left is cleared by the next one; files of the user's that only look alike
// stay.
TEST(ListFiles, AListSaveClearsWhatAKilledOneLeft)
{
    TempDir dir;
    dir.write(".quillmark-save-0123456789abcdef", "A\r\n");
    dir.write(".quillmark-save-99999-notes.txt", "notes");
    WriteListFile(dir.file("bfc.txt"), {"A"});
    EXPECT_EQ(NamesIn(dir.path()), (std::set<std::string>{"bfc.txt", ".quillmark-save-99999-notes.txt"}));
}

} // namespace
