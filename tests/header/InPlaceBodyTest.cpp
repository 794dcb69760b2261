// SPDX-License-Identifier: MIT
// The body is built inside the buffer the file was read into: every kind of line must come out
// exactly as a separate copy would have made it, and the buffer itself must become the body.
#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

#include "LineEnds.h"
#include "ParseProgress.h"
#include "Parser.h"
#include "ScriptedDialogs.h"

namespace {

HeaderData parsed(std::string content)
{
    HeaderData header;
    ScriptedDialogs dialogs;
    ParseProgress progress;
    ParsePartFileContent(header, std::move(content), dialogs, progress);
    return header;
}

// Lines as a part file holds them, joined by the given line end.
std::string joined(std::initializer_list<std::string> lines, const std::string& lineEnd)
{
    std::string text;
    for (const auto& line : lines)
        text += line + lineEnd;
    return text;
}

// A header with an unknown meta line (header and body both), then trimmed lines, an inner empty
// line, a blank-only line and a last line without line end.
const std::initializer_list<std::string> MixedLines = {
    "0 Brick", "0 Name: b.dat", "", "0 FOO  bar ", "  1 16 a.dat  ", "", "   ", "2 24 0 0 0 1 1 1"};
const std::string MixedBody = "0 FOO  bar\r\n1 16 a.dat\r\n\r\n\r\n2 24 0 0 0 1 1 1\r\n4 16 y";

TEST(InPlaceBody, CrLfAndLfOnlyLinesAreTrimmedAndJoinedByCrLf)
{
    const auto h = parsed(joined(MixedLines, "\r\n") + " 4 16 y");
    EXPECT_EQ(h.Body, MixedBody);
    EXPECT_EQ(h.OldHeader, "0 Brick\r\n0 Name: b.dat\r\n0 FOO  bar ");
    EXPECT_EQ(parsed(joined(MixedLines, "\n") + " 4 16 y").Body, MixedBody);
    EXPECT_EQ(parsed(joined(MixedLines, "\n") + " 4 16 y\n").Body, MixedBody + "\r\n") << "one more, empty, line";
}

TEST(InPlaceBody, AFileThatIsAllHeaderHasAnEmptyBody)
{
    const auto h = parsed("0 a\r\n0 // c\r\n\r\n0 !KEYWORDS k\r\n");
    EXPECT_EQ(h.Body, "");
    EXPECT_EQ(h.OldHeader, "0 a\r\n0 // c\r\n0 !KEYWORDS k");
}

TEST(InPlaceBody, ABodyLineLongerThanTheHeaderBeforeIt)
{
    const std::string longLine = "1" + std::string(5000, 'x');
    EXPECT_EQ(parsed("0 h\r\n " + longLine + " \r\n2 y").Body, longLine + "\r\n2 y");
}

// A CR alone ends a line but is shorter than the CR LF that joins the body: the body must not
// overwrite the lines still to be read.
TEST(InPlaceBody, LinesEndedByACrAloneAreJoinedByCrLf)
{
    EXPECT_EQ(parsed("1 a\r1 b\r 1 c \r\r1 d").Body, "1 a\r\n1 b\r\n1 c\r\n\r\n1 d");
    EXPECT_EQ(parsed("1 a\r\n1 b\r\n1 c\r1 d\r1 e").Body, "1 a\r\n1 b\r\n1 c\r\n1 d\r\n1 e");
    EXPECT_EQ(parsed("1 a\n1 b\r1 c\n1 d\r1 e").Body, "1 a\r\n1 b\r\n1 c\r\n1 d\r\n1 e") << "LF only, with CRs alone";
}

TEST(InPlaceBody, TheContentsBufferBecomesTheBody)
{
    std::string body;
    for (int line = 0; line < 1000; ++line)
        body += "1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat\r\n";
    std::string crLf = "0 h\r\n" + body;
    const char* crLfBuffer = crLf.data();
    EXPECT_EQ(parsed(std::move(crLf)).Body.data(), crLfBuffer);

    std::string lfOnly = "0 h\n" + body;
    std::erase(lfOnly, '\r');
    lfOnly.reserve(2 * lfOnly.size() + 2); // the room the file reader leaves
    const char* lfBuffer = lfOnly.data();
    const auto h = parsed(std::move(lfOnly));
    EXPECT_EQ(h.Body, body);
    EXPECT_EQ(h.Body.data(), lfBuffer);
}

// The pages of a long header are given back as it is read: the body lines among its lines and
// after it must keep every byte.
TEST(InPlaceBody, AHeaderOfManyMegabytesKeepsEveryBodyByte)
{
    std::string text = "0 d\r\n";
    std::string body;
    for (int line = 0; line < 1200000; ++line) { // more than the pages given back at a time
        if (line % 100000 == 0) {
            const auto meta = "0 FOO " + std::to_string(line);
            text += meta + "\r\n";
            body += meta + "\r\n";
        }
        text += "0 // c\r\n";
    }
    const auto h = parsed(text + "1 end");
    EXPECT_EQ(h.Body, body + "1 end");
    EXPECT_EQ(h.Comments.size(), 1200000u);
    EXPECT_EQ(h.OldHeader.size(), text.size() - 2);
}

// Most of a body is passed over many lines at a time: the lines among them that need trimming or
// end with a CR alone must come out as if every line had been taken one by one.
TEST(InPlaceBody, IrregularLinesAmongManyPlainOnesComeOutTrimmed)
{
    const std::vector<std::pair<std::string, std::string>> irregular = {
        {" 2 x", "2 x"}, {"3 y  ", "3 y"}, {"   ", ""}, {"", ""}, {"4 z\r10 w", "4 z\r\n10 w"}};
    std::string text = "0 h\r\n";
    std::string body;
    for (std::size_t line = 0; line < 5000; ++line) {
        const bool odd = line % 37 == 5;
        const auto& [read, kept] = irregular[line % irregular.size()];
        text += odd ? read : "1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat";
        text += "\r\n";
        body += (line == 0 ? "" : "\r\n") + (odd ? kept : std::string("1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat"));
    }
    EXPECT_EQ(parsed(text).Body, body);
}

// The encoding is decided while the text is read, before its bytes are moved: every byte counts,
// the last ones too, and characters of several bytes may cross any boundary.
TEST(InPlaceBody, TheWholeTextDecidesTheEncoding)
{
    std::string utf8 = "0 \xC3\xA9t\xC3\xA9\r\n";
    for (int line = 0; line < 40000; ++line) // far beyond the first piece that is checked
        utf8 += line % 7 == 0 ? "1 \xE2\x82\xAC \r\n" : "2 \xC3\xA9\r\n";
    EXPECT_EQ(parsed(utf8).Encoding, TextEncoding::Utf8);
    EXPECT_EQ(parsed(utf8 + "3 \xE9").Encoding, TextEncoding::Latin1);
    std::string plain;
    for (int line = 0; line < 40000; ++line)
        plain += line == 30000 ? "1 \xE9 a.dat\r\n" : "1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat\r\n";
    EXPECT_EQ(parsed(plain).Encoding, TextEncoding::Latin1) << "deep inside lines kept as they stand";
    std::string longLine = "1 ";
    for (int character = 0; character < 200000; ++character)
        longLine += "\xC3\xA9";
    EXPECT_EQ(parsed("1 a\r" + longLine + "\r\n" + longLine + "\r\n" + longLine).Encoding, TextEncoding::Utf8)
        << "after the rest was moved";
    EXPECT_EQ(parsed("1 a\r1 \xE9\r1 b").Encoding, TextEncoding::Latin1) << "after the rest was moved";
}

TEST(LineEndConversion, LfAloneBecomesCrLfWhereTheTextLies)
{
    std::string text = "\na\nb\r\nc\n\n";
    LfToCrLf(text);
    EXPECT_EQ(text, "\r\na\r\nb\r\nc\r\n\r\n");
}

TEST(LineEndConversion, WideningMovesTheRestBackAndEndsEveryLineWithCrLf)
{
    std::string text = "ab\rcd\r\ne\r";
    WidenLoneCrs(text, 2, 2);
    EXPECT_EQ(text.substr(0, 2), "ab");
    EXPECT_EQ(text.substr(4), "\r\ncd\r\ne\r\n");
    text = "a\rb\rc";
    WidenLoneCrs(text, 3, 0);
    EXPECT_EQ(text, "a\rb\r\nc") << "what lies before the position stays";
}

} // namespace
