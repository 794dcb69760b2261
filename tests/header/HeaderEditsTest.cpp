// SPDX-License-Identifier: MIT
// The header edits that quillmark-cli edit makes on many files at once.
#include <gtest/gtest.h>

#include "HeaderEdits.h"

namespace {

const LocalDateTime Today{2024, 5, 6, 12, 0, 0};

HeaderData partRecord()
{
    HeaderData h;
    h.FilePath = "/lib/parts/s/3001s01.dat";
    h.PartName = "3001s01.dat";
    h.AuthorRealName = "Sam Sample";
    h.AuthorUserName = "ssample";
    h.PartType = "Unofficial_Subpart";
    h.License = "Redistributable under CCAL version 2.0 : see CAreadme.txt";
    h.Bfc = "CERTIFY CCW";
    h.Category = "Brick";
    h.Keywords = {"Bricks, wall", "Corner"};
    h.History = {"2004-03-04 [ssample] made"};
    return h;
}

TEST(HeaderEdits, EachSetFieldChangesTheRecordAndNothingElse)
{
    auto h = partRecord();
    HeaderEdits edits;
    edits.description = "~Brick  2 x 4";
    edits.author = "[jtester]";
    edits.type = "Part";
    edits.update = "2024-01";
    edits.bfc = "NOCERTIFY";
    edits.category = "";
    edits.addKeywords = SplitKeywords("WALL, Stud, stud,");
    edits.removeKeywords = {"bricks", "corner"};
    edits.addHistory = "Header edits";
    edits.historyUser = "jtester";
    edits.nameFromPath = true;
    EXPECT_EQ(ApplyHeaderEdits(h, edits, Today), std::nullopt);
    EXPECT_EQ(h.PartDescription, "~Brick  2 x 4");
    EXPECT_EQ(h.AuthorRealName, "Sam Sample");
    EXPECT_EQ(h.AuthorUserName, "jtester");
    EXPECT_EQ(h.PartType, "Part");
    EXPECT_EQ(h.UpdateTag, "2024-01");
    EXPECT_EQ(h.License, partRecord().License);
    EXPECT_EQ(h.Bfc, "NOCERTIFY");
    EXPECT_EQ(h.Category, "");
    EXPECT_EQ(h.Keywords, (EntryList{"wall", "Stud"}));
    EXPECT_EQ(h.History, (EntryList{"2004-03-04 [ssample] made", "2024-05-06 [jtester] Header edits"}));
    EXPECT_EQ(h.PartName, "3001s01.dat") << "the type set before the name";
    edits = {};
    edits.author = " Jo Tester  ";
    ApplyHeaderEdits(h, edits, Today);
    EXPECT_EQ(h.AuthorRealName + "|" + h.AuthorUserName, "Jo Tester|jtester");
}

TEST(HeaderEdits, CurrentLicenceByTheNewestHistoryDateAndCc0Kept)
{
    HeaderEdits edits;
    edits.license = std::string(CurrentLicense);
    for (const auto& [history, wanted] :
         {std::pair{"2023-03-04 [a] x", CcBy2And4License}, std::pair{"2023-03-05 [a] x", CcBy4License},
          std::pair{"05-03-2023 [a] x", CcBy2And4License}}) {
        auto h = partRecord();
        h.History.push_back(history);
        ApplyHeaderEdits(h, edits, Today);
        EXPECT_EQ(h.License, wanted) << history;
    }
    auto h = partRecord();
    edits.addHistory = "Header edits";
    ApplyHeaderEdits(h, edits, Today);
    EXPECT_EQ(h.License, CcBy4License) << "the history line the same edit adds";
    h.License = Cc0License;
    ApplyHeaderEdits(h, edits, Today);
    EXPECT_EQ(h.License, Cc0License);
}

TEST(HeaderEdits, NameFromPathWithTheFolderOfTheType)
{
    for (const auto& [type, name] :
         {std::pair{"Subpart", "s\\3001s01.dat"}, std::pair{"Unofficial_8_Primitive", "8\\3001s01.dat"},
          std::pair{"48_Primitive", "48\\3001s01.dat"}, std::pair{"Helper", "helpers\\3001s01.dat"},
          std::pair{"Part Alias", "3001s01.dat"}, std::pair{"Unofficial_Primitive", "3001s01.dat"}}) {
        auto h = partRecord();
        h.PartType = type;
        HeaderEdits edits;
        edits.nameFromPath = true;
        ApplyHeaderEdits(h, edits, Today);
        EXPECT_EQ(h.PartName, name) << type;
    }
}

TEST(HeaderEdits, AWindingIsNeverTurnedRound)
{
    auto h = partRecord();
    HeaderEdits edits;
    edits.bfc = "CERTIFY CW";
    edits.description = "changed";
    EXPECT_EQ(
        ApplyHeaderEdits(h, edits, Today),
        "the BFC statement CERTIFY CCW is not turned into CERTIFY CW: that needs every polygon's winding reversed");
    EXPECT_EQ(h.PartDescription, "");
    edits.bfc = "NOCERTIFY";
    EXPECT_EQ(ApplyHeaderEdits(h, edits, Today), std::nullopt);
}

} // namespace
