// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <sys/stat.h>
#include <unistd.h>

#include "ListEditor.h"
#include "ScriptedDialogs.h"
#include "StandardLists.h"
#include "TempDir.h"

namespace {

class ListEditing : public ::testing::Test {
protected:
    ListEditor editor(ListKind kind, const StringList& entries)
    {
        return ListEditor(kind, entries, dir.path().string(), dialogs);
    }
    TempDir dir;
    ScriptedDialogs dialogs;
};

TEST_F(ListEditing, WorkingCopyIsSortedIgnoringCase)
{
    auto list = editor(ListKind::PartType, {"b", "A", "<none>", "a", "C"});
    EXPECT_EQ(list.entries(), (StringList{"<none>", "A", "a", "b", "C"}));
    EXPECT_FALSE(list.ListChanged());
}

TEST_F(ListEditing, AddNormalisesByMode)
{
    auto categories = editor(ListKind::Category, {"Technic"});
    dialogs.expectInput("  technic BEAM ");
    dialogs.expectInput("x");
    dialogs.expectInput("TECHNIC");
    dialogs.expectInput("   ");
    for (int i = 0; i < 4; ++i)
        categories.add();
    EXPECT_EQ(categories.entries(), (StringList{"Technic", "Technic Beam", "X"}));
    EXPECT_TRUE(categories.ListChanged());

    auto bfc = editor(ListKind::Bfc, {});
    dialogs.expectInput("certify ccw");
    bfc.add();
    EXPECT_EQ(bfc.entries(), (StringList{"CERTIFY CCW"}));

    auto types = editor(ListKind::PartType, {"part"});
    dialogs.expectInput("Part");
    types.add();
    EXPECT_EQ(types.entries(), (StringList{"part", "Part"}));

    auto licenses = editor(ListKind::License, {});
    dialogs.expectInput("  Licensed under cc BY 4.0 ");
    licenses.add();
    EXPECT_EQ(licenses.entries(), (StringList{"Licensed under cc BY 4.0"}));
}

TEST_F(ListEditing, SelectionStaysOnItsEntryWhenAnAddedOneGoesBeforeIt)
{
    auto list = editor(ListKind::Bfc, {"NOCERTIFY", "CERTIFY CW"});
    list.select(0); // CERTIFY CW, which the added entry goes just before
    dialogs.expectInput("certify ccw");
    list.add();
    list.deleteSelected();
    EXPECT_EQ(list.entries(), (StringList{"CERTIFY CCW", "NOCERTIFY"}));
}

TEST_F(ListEditing, DuplicateOrCancelledAddChangesNothing)
{
    auto list = editor(ListKind::Bfc, {"NOCERTIFY"});
    dialogs.expectInput("nocertify");
    dialogs.expectInput("");
    list.add();
    list.add();
    EXPECT_FALSE(list.ListChanged());
}

TEST_F(ListEditing, DeleteRemovesTheSelectedEntryButNeverNone)
{
    for (const auto kind : {ListKind::Category, ListKind::PartType, ListKind::Bfc, ListKind::License}) {
        auto list = editor(kind, {"<none>", "B", "a"});
        list.deleteSelected();
        EXPECT_FALSE(list.ListChanged());
        list.select(0);
        dialogs.expectMessage(Answer::Ok);
        list.deleteSelected();
        EXPECT_EQ(list.entries().size(), 3u);
        EXPECT_EQ(dialogs.messages.back().text, "The entry '<none>' is not allowed to delete.");
        list.select(2);
        EXPECT_EQ(list.updateText(), "B");
        list.deleteSelected();
        EXPECT_EQ(list.entries(), (StringList{"<none>", "a"}));
        EXPECT_EQ(list.updateText(), "");
        EXPECT_FALSE(list.selected());
        EXPECT_TRUE(list.ListChanged());
    }
}

TEST_F(ListEditing, UpdateReplacesTheSelectedEntry)
{
    auto list = editor(ListKind::Category, {"<none>", "Brick", "Plate"});
    list.select(1);
    list.setUpdateText(" tile  round ");
    list.updateSelected();
    EXPECT_EQ(list.entries(), (StringList{"<none>", "Plate", "Tile  Round"}));
    EXPECT_EQ(list.selected(), std::optional<std::size_t>(2));
    EXPECT_TRUE(list.ListChanged());

    list.select(1);
    list.setUpdateText("tile  round");
    list.updateSelected();
    list.setUpdateText(" ");
    list.updateSelected();
    EXPECT_EQ(list.entries(), (StringList{"<none>", "Plate", "Tile  Round"}));

    list.select(0);
    list.setUpdateText("Other");
    dialogs.expectMessage(Answer::Ok);
    list.updateSelected();
    EXPECT_EQ(dialogs.messages.back().text, "The entry '<none>' is not allowed to change.");
    EXPECT_EQ(list.entries().front(), "<none>");
}

TEST_F(ListEditing, CloseAsksOnlyAfterAChangeAndWritesOnYes)
{
    const auto path = ListFilePath(dir.path().string(), ListKind::License);
    auto unchanged = editor(ListKind::License, {"b", "a"});
    EXPECT_TRUE(unchanged.close());
    EXPECT_TRUE(dialogs.messages.empty());

    auto list = editor(ListKind::License, {"b", "a", "c"});
    list.select(2);
    list.deleteSelected();
    dialogs.expectMessage(Answer::Cancel);
    EXPECT_FALSE(list.close());
    EXPECT_EQ(dialogs.messages.back().title, "Changed Categories"); // for every list
    EXPECT_EQ(dialogs.messages.back().defaultButton, Answer::Cancel);
    EXPECT_FALSE(std::filesystem::exists(path));

    dialogs.expectMessage(Answer::No);
    EXPECT_TRUE(list.close());
    EXPECT_FALSE(std::filesystem::exists(path));

    dialogs.expectMessage(Answer::Yes);
    EXPECT_TRUE(list.close());
    EXPECT_EQ(ReadBytes(path), "a\r\nb\r\n");
}

TEST_F(ListEditing, UnwritableFileIsReportedAndTheDialogStays)
{
    const auto path = dir.write("bfc.txt", "A\r\n");
    ::chmod(path.c_str(), 0444);
    auto list = editor(ListKind::Bfc, {"A"});
    dialogs.expectInput("B");
    list.add();
    dialogs.expectMessage(Answer::Yes);
    dialogs.expectMessage(Answer::Ok);
    EXPECT_FALSE(list.close());
    EXPECT_EQ(dialogs.messages.back().text,
              "Error 70 (Permission denied) in procedure cmdClose_Click of Formular frmList\r\n" + path +
                  ": Permission denied");
    EXPECT_EQ(ReadBytes(path), "A\r\n");
    EXPECT_TRUE(list.ListChanged());
}

} // namespace
