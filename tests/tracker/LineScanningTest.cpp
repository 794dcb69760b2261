// SPDX-License-Identifier: MIT
// How the Tracker's rules read a line's bytes: the same wherever in a long line a byte stands.
#include <gtest/gtest.h>

#include "GeometryLine.h"
#include "NumberFormats.h"
#include "TrackerTestParts.h"
#include "TrackerText.h"

namespace {

const std::string Quad = "4 16 -10.5 0 10 10 0 10 10 0 -10 -10 0 -11"; // no part of it is "0" alone

std::vector<TrackerLine> linesOf(std::string_view text)
{
    std::vector<TrackerLine> lines;
    TrackerLines reader(text);
    for (TrackerLine line; reader.next(line);)
        lines.push_back(line);
    return lines;
}

TEST(LineScanning, NumberFindingsStandAnywhereInALine)
{
    // After a first word of 0 to 40 letters, each number stands at every offset of the line.
    for (std::size_t letters = 0; letters <= 40; ++letters) {
        const auto before = std::string(letters, 'a') + ' ';
        EXPECT_EQ(CheckNumberFormats(before + "01 5").leadingZero, "01") << letters;
        EXPECT_EQ(CheckNumberFormats(before + "-01 5").leadingZero, "-01") << letters;
        EXPECT_EQ(CheckNumberFormats(before + "-00.5 5").leadingZero, "-00.5") << letters;
        EXPECT_EQ(CheckNumberFormats(before + "2.0").trailingZero, "2.0") << letters;
        EXPECT_EQ(CheckNumberFormats(before + "2.50 5").trailingZero, "2.50") << letters;
        EXPECT_EQ(CheckNumberFormats(before + "0.123456 5").tooPrecise, "0.123456") << letters;
        const auto passing = CheckNumberFormats(before + "10.5 100 1.05 -0.5 0.12345 a01 0 01");
        EXPECT_TRUE(passing.leadingZero.empty() && passing.trailingZero.empty() && passing.tooPrecise.empty())
            << letters;
    }
}

TEST(LineScanning, NumbersReadToTheirExactValues)
{
    // Runs of digits shorter and longer than eight, before and after the dot, inside the line and
    // as its last word.
    const std::pair<const char*, double> numbers[] = {{"7", 7.0},
                                                      {"0.3", 0.3}, // not 3 * 0.1
                                                      {"-0.00003", -0.00003},
                                                      {"12345678", 12345678.0},
                                                      {"123456789", 123456789.0},
                                                      {"-9876543210.5", -9876543210.5},
                                                      {"0.12345678", 0.12345678},
                                                      {"1.000000001", 1.000000001},
                                                      {"-.5", -0.5},
                                                      {"87654321.1234567", 87654321.1234567},
                                                      {"123456789012345", 123456789012345.0},
                                                      {"1234567890123456", 1234567890123456.0}};
    for (const auto& [text, value] : numbers) {
        const auto line = std::string("2 24 ") + text + " 0 0 1 1 " + text;
        GeometryLine read;
        ASSERT_TRUE(ReadGeometryLine(line, read)) << line;
        EXPECT_EQ(read.numbers[0], value) << text;
        EXPECT_EQ(read.numbers[5], value) << text;
    }
}

TEST(LineScanning, BlanksMakeALineOtherThanPlainAnywhere)
{
    ASSERT_EQ(linesOf(Quad).size(), 1u);
    EXPECT_TRUE(linesOf(Quad)[0].plain);
    for (std::size_t at = 1; at < Quad.size(); ++at) {
        if (Quad[at] != ' ')
            continue;
        for (const auto* blanks : {"  ", "\t", " \xC2\xA0"}) {
            const auto line = Quad.substr(0, at) + blanks + Quad.substr(at + 1);
            const auto lines = linesOf(line);
            ASSERT_EQ(lines.size(), 1u) << line;
            EXPECT_FALSE(lines[0].plain) << line;
            EXPECT_EQ(bodyFindings(line + "\r\n"), LineIds{}) << "its blanks are collapsed: " << line;
        }
    }
    EXPECT_FALSE(linesOf(Quad + " \xC3\xA9")[0].plain) << "a letter above ASCII";
}

TEST(LineScanning, EveryBreakEndsALineAnywhere)
{
    for (const auto* lineBreak : {"\r", "\n", "\r\n", "\v", "\f", "\xC2\x85", "\xE2\x80\xA8", "\xE2\x80\xA9"})
        for (std::size_t at = 1; at < Quad.size(); ++at) {
            const auto text = Quad.substr(0, at) + lineBreak + Quad.substr(at) + "\r\n";
            const auto lines = linesOf(text);
            ASSERT_EQ(lines.size(), 2u) << at;
            EXPECT_EQ(lines[0].text, TrimTrackerLine(Quad.substr(0, at))) << at;
            EXPECT_EQ(lines[1].text, TrimTrackerLine(Quad.substr(at))) << at;
            EXPECT_EQ(lines[1].number, 2) << at;
        }
}

TEST(LineScanning, AZeroBeforeBlanksAloneIsAnInvalidLine)
{
    // Not emptied as "0" or "0 //" are: trimmed, it is a type 0 line without a word.
    EXPECT_EQ(bodyFindings("1 16 0 0 0 1 0 0 0 1 0 0 0 1 stud.dat\r\n0 \t \r\n"), (LineIds{{2, "line.invalid"}}));
}

} // namespace
