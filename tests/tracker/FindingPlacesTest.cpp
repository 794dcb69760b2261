// SPDX-License-Identifier: MIT
// Where on disk a finding lies: line and column as editors count them, and the bytes it is about,
// whatever line ends the file has.
#include <gtest/gtest.h>

#include "Composer.h"
#include "FindingPlaces.h"
#include "LineEndText.h"
#include "ParseProgress.h"
#include "Parser.h"
#include "ScriptedDialogs.h"
#include "TrackerTestParts.h"

namespace {

struct Placed {
    std::string id;
    FindingPlace place;
    std::string bytes; // what the range holds
};

// The findings of the file's bytes with their places.
std::vector<Placed> placedFindings(const std::string& bytes)
{
    HeaderData header;
    header.FilePath = "/lib/parts/3001.dat";
    ParseProgress progress;
    ScriptedDialogs dialogs;
    ParsePartFileContent(header, bytes, dialogs, progress);
    const auto composed = ComposeHeader(header);
    const FindingPlaces places(bytes, header, composed);
    std::vector<Placed> placed;
    for (const auto& finding : CheckRecordForTracker(header, composed, Categories, Colours())) {
        const auto place = places.of(finding);
        placed.push_back({finding.id, place, bytes.substr(place.begin, place.end - place.begin)});
    }
    return placed;
}

const Placed& findingOf(const std::vector<Placed>& placed, const std::string& id)
{
    static const Placed none{"none", {}, {}};
    for (const auto& finding : placed)
        if (finding.id == id)
            return finding;
    ADD_FAILURE() << "no finding " << id;
    return none;
}

TEST(FindingPlaces, ANumberIsPlacedOnItsLineAndColumnWhateverTheLineEnds)
{
    const auto crLf = cleanPart("Brick  2 x  4", "3001.dat", "Part", "3 16  1.50 0 0 1 0 0 0 1 0\r\n");
    for (const auto& end : {"\r\n", "\n"}) {
        const auto found = findingOf(placedFindings(WithLineEnds(crLf, end)), "numbers.trailingzeros");
        EXPECT_FALSE(found.place.wholeFile);
        EXPECT_EQ(found.place.line, 9u) << "after the eight header lines and blank lines";
        EXPECT_EQ(found.place.column, 7u);
        EXPECT_EQ(found.bytes, "1.50");
    }
}

TEST(FindingPlaces, ALoneCrStaysInsideItsLine)
{
    // The parser and the Tracker end a line at the lone CR; editors and "path:line:col" readers do
    // not, so the number after it is on the same line, further right.
    const auto text = cleanPart("Brick  2 x  4", "3001.dat", "Part",
                                "2 24 0 0 0 1 0 0\r3 16 1.50 0 0 1 0 0 0 1 0\r\n"
                                "0 // a comment\r with a CR\r\n4 16 0 0 0 01 0 0 1 1 0 0 1 0\r\n");
    const auto placed = placedFindings(text);
    const auto trailing = findingOf(placed, "numbers.trailingzeros");
    EXPECT_EQ(trailing.place.line, 9u);
    EXPECT_EQ(trailing.place.column, 23u) << "the 16 bytes before the CR, the CR, then \"3 16 \"";
    EXPECT_EQ(trailing.bytes, "1.50");
    const auto leading = findingOf(placed, "numbers.leadingzeros");
    EXPECT_EQ(leading.place.line, 11u) << "a lone CR inside a line is no line break";
    EXPECT_EQ(leading.place.column, 12u);
    EXPECT_EQ(leading.bytes, "01");
}

TEST(FindingPlaces, AHeaderFindingIsPlacedOnItsLinesValue)
{
    auto text = cleanPart();
    text.replace(text.find("Licensed under CC BY 4.0"), 24, "Redistributable");
    const auto placed = placedFindings(WithLineEnds(text, "\n"));
    const auto licence = findingOf(placed, "license.approved");
    EXPECT_EQ(licence.place.line, 5u);
    EXPECT_EQ(licence.place.column, 12u);
    EXPECT_EQ(licence.bytes, "Redistributable : see CAreadme.txt");

    const auto missing = findingOf(placedFindings("0 Brick 2 x 4\n1 16 0 0 0 1 0 0 0 1 0 0 0 1 stud.dat\n"), "missing");
    EXPECT_TRUE(missing.place.wholeFile) << "a finding about the file as a whole";
    EXPECT_EQ(missing.place.line, 1u);
    EXPECT_EQ(missing.place.column, 1u);
}

TEST(FindingPlaces, ALineFindingCoversItsLine)
{
    const auto text = cleanPart("Brick  2 x  4", "3001.dat", "Part", "\r\n\r\n7 16 junk\r\n");
    const auto invalid = findingOf(placedFindings(text), "line.invalid");
    EXPECT_EQ(invalid.place.line, 11u) << "blank lines count on disk";
    EXPECT_EQ(invalid.place.column, 1u);
    EXPECT_EQ(invalid.bytes, "7 16 junk");
}

} // namespace
