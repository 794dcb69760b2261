// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <mutex>

#include "CheckQueue.h"
#include "Completion.h"
#include "Documents.h"
#include "TextPositions.h"

namespace {

// "é" is two bytes and one UTF-16 unit, "😀" four bytes and two units.
const std::string Mixed = "a\r\nb\xC3\xA9x\ncc\r\rd\xF0\x9F\x98\x80z";

} // namespace

TEST(TextPositions, CountLinesByCrLfLfAndCr)
{
    const LineIndex lines(Mixed);
    ASSERT_EQ(lines.lineCount(), 5u);
    EXPECT_EQ(lines.lineStart(1), 3u);
    EXPECT_EQ(lines.lineStart(2), 8u);
    EXPECT_EQ(lines.lineStart(3), 11u); // after a lone CR
    EXPECT_EQ(lines.lineStart(4), 12u); // an empty line between two lone CRs
    EXPECT_EQ(lines.contentEnd(Mixed, 0), 1u);
    EXPECT_EQ(lines.contentEnd(Mixed, 3), 11u);
    EXPECT_EQ(LineIndex("").lineCount(), 1u);
    EXPECT_EQ(LineIndex("a\r\n").lineCount(), 2u);
}

TEST(TextPositions, CountColumnsInUtf16UnitsOrUtf8Bytes)
{
    const LineIndex lines(Mixed);
    const auto utf16 = PositionEncoding::Utf16;
    const auto utf8 = PositionEncoding::Utf8;
    EXPECT_EQ(lines.offsetOf(Mixed, {1, 2}, utf16), 6u); // after "bé"
    EXPECT_EQ(lines.offsetOf(Mixed, {1, 2}, utf8), 5u);
    EXPECT_EQ(lines.offsetOf(Mixed, {4, 3}, utf16), 17u);     // after "d😀"
    EXPECT_EQ(lines.offsetOf(Mixed, {4, 2}, utf16), 12u + 1); // inside the pair: the character's start
    EXPECT_EQ(lines.offsetOf(Mixed, {0, 9}, utf16), 1u);      // past the line's end: its end
    EXPECT_EQ(lines.offsetOf(Mixed, {9, 0}, utf16), Mixed.size());
    EXPECT_EQ(lines.positionOf(Mixed, 6, utf16), (TextPosition{1, 2}));
    EXPECT_EQ(lines.positionOf(Mixed, 17, utf16), (TextPosition{4, 3}));
    EXPECT_EQ(lines.positionOf(Mixed, 17, utf8), (TextPosition{4, 5}));
    EXPECT_EQ(lines.positionOf(Mixed, 2, utf16), (TextPosition{0, 1})); // between CR and LF: the line's end
    // A byte that starts no UTF-8 character counts as one unit.
    const std::string latin1 = "x\xE9y";
    EXPECT_EQ(LineIndex(latin1).offsetOf(latin1, {0, 2}, utf16), 2u);
}

TEST(TextPositions, ChangesEditTheTextInTheirOrder)
{
    Documents documents;
    documents.open("file:///p/a.dat", "0 one\r\n0 two\r\n0 three\r\n", 1);
    const auto range = [](std::size_t l1, std::size_t c1, std::size_t l2, std::size_t c2) {
        return std::optional(std::pair{TextPosition{l1, c1}, TextPosition{l2, c2}});
    };
    ASSERT_TRUE(documents.change("file:///p/a.dat", 2,
                                 {{range(0, 2, 0, 2), "the "},     // insert
                                  {range(1, 2, 1, 5), ""},         // delete
                                  {range(1, 2, 2, 3), "2\r\n0 t"}, // across lines
                                  {range(0, 9, 1, 0), "\r"},       // a CR LF becomes a lone CR
                                  {range(1, 0, 1, 0), "\n"}},      // and a CR LF again
                                 PositionEncoding::Utf16));
    const auto* document = documents.find("file:///p/a.dat");
    EXPECT_EQ(document->text, "0 the one\r\n0 2\r\n0 three\r\n");
    EXPECT_EQ(document->version, 2);
    EXPECT_EQ(document->lines().lineCount(), 4u);
    // Both ends of a range count UTF-16 units: the character of two units goes whole.
    documents.open("file:///p/c.dat", "0 \xF0\x9F\x98\x80 one\r\n", 1);
    ASSERT_TRUE(documents.change("file:///p/c.dat", 2, {{range(0, 2, 0, 4), ""}}, PositionEncoding::Utf16));
    EXPECT_EQ(documents.find("file:///p/c.dat")->text, "0  one\r\n");
    EXPECT_FALSE(documents.change("file:///p/b.dat", 2, {{std::nullopt, ""}}, PositionEncoding::Utf16));
    ASSERT_TRUE(documents.change("file:///p/a.dat", 3, {{std::nullopt, "0 new"}}, PositionEncoding::Utf16));
    EXPECT_EQ(document->text, "0 new");
}

TEST(TextPositions, FileUrisNameLocalPaths)
{
    EXPECT_EQ(PathOfUri("file:///home/ann/My%20Parts/3001%23.dat"), "/home/ann/My Parts/3001#.dat");
    EXPECT_EQ(PathOfUri("file://server/share/3001.dat"), std::nullopt);
    EXPECT_EQ(PathOfUri("untitled:Untitled-1"), std::nullopt);
}

TEST(LspCompletion, OffersCategoriesInForceOnly)
{
    EXPECT_EQ(CategoriesInForce({"<none>", "Brick", "Minifig", "Minifig Arm", "Lever", "Plate"}),
              (StringList{"Brick", "Minifig Arm", "Plate"}));
}

TEST(LspChecks, ANewerVersionReplacesTheCheckThatWaits)
{
    std::mutex mutex;
    std::vector<std::string> ran;
    std::condition_variable done;
    {
        CheckQueue checks(std::chrono::milliseconds(100));
        const auto job = [&](const std::string& uri, long long version) {
            return CheckQueue::Job{uri, version, [&, uri, version] {
                                       const std::lock_guard lock(mutex);
                                       ran.push_back(uri + " " + std::to_string(version));
                                       done.notify_all();
                                   }};
        };
        checks.schedule(job("a", 1));
        checks.schedule(job("b", 1));
        checks.schedule(job("a", 2));
        checks.schedule(job("c", 1));
        checks.forget("c");
        std::unique_lock lock(mutex);
        ASSERT_TRUE(done.wait_for(lock, std::chrono::seconds(30),
                                  [&] { return std::find(ran.begin(), ran.end(), "a 2") != ran.end(); }));
    }
    EXPECT_EQ(ran, (std::vector<std::string>{"b 1", "a 2"}));
}
