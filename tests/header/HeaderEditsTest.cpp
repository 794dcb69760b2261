// SPDX-License-Identifier: MIT
// The header edits that quillmark-cli edit makes on many files at once.
#include <gtest/gtest.h>
#include <tuple>

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

// A licence is never widened: only a file under neither current text gets one, by the date of
// its first history line.
TEST(HeaderEdits, CurrentLicenceKeepsTheCurrentTextsAndDatesTheOthersByTheFirstHistoryLine)
{
    const std::string other(partRecord().License);
    HeaderEdits edits;
    edits.license = std::string(CurrentLicense);
    edits.addHistory = "Header edits"; // dated today, and never the first line that counts
    edits.historyUser = "jtester";
    const EntryList none, before{"2023-03-04 [a] x", "2024-01-01 [b] y"}, since{"2023-03-05 [a] x"},
        undated{"05-03-2023 [a] x"};
    for (const auto& [license, history, wanted] : {std::tuple{std::string(CcBy4License), none, CcBy4License},
                                                   {std::string(CcBy4License), before, CcBy4License},
                                                   {std::string(Cc0License), none, Cc0License},
                                                   {std::string(Cc0License), before, Cc0License},
                                                   {other, none, CcBy2And4License},
                                                   {other, before, CcBy2And4License},
                                                   {other, undated, CcBy2And4License},
                                                   {other, since, CcBy4License}}) {
        auto h = partRecord();
        h.License = license;
        h.History = history;
        ApplyHeaderEdits(h, edits, Today);
        EXPECT_EQ(h.License, wanted) << license << " with " << history.size() << " history lines";
    }
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
