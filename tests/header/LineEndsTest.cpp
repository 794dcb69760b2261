// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <sys/stat.h>

#include "ParseProgress.h"
#include "Parser.h"
#include "ScriptedDialogs.h"
#include "TempDir.h"

namespace {

class PartFileParse : public ::testing::Test {
protected:
    HeaderData open(const std::string& bytes)
    {
        header.FilePath = dir.write("part.dat", bytes);
        GetGlobalContent(header, dialogs, progress);
        return header;
    }
    TempDir dir;
    HeaderData header;
    ScriptedDialogs dialogs;
    ParseProgress progress;
};

TEST_F(PartFileParse, LfOnlyFileIsConvertedInMemoryOnly)
{
    const std::string bytes = "0 Brick\n0 Name: ro.dat\n1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat\n";
    header.FilePath = dir.write("ro.dat", bytes);
    ::chmod(header.FilePath.c_str(), 0444); // opening never writes, so a read-only file opens too
    GetGlobalContent(header, dialogs, progress);
    EXPECT_EQ(header.OldHeader, "0 Brick\r\n0 Name: ro.dat");
    // The conversion appends one CR LF, which reads as one more empty line at the end.
    EXPECT_EQ(header.Body, "1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat\r\n");
    EXPECT_EQ(ReadBytes(header.FilePath), bytes);
}

// The first line decides: a file whose first line ends in LF alone is converted to CR LF as a
// whole; otherwise a lone LF stays inside its line and CR alone ends a line.
TEST_F(PartFileParse, TheFirstLineEndDecidesHowTheFileIsRead)
{
    const std::string line = "1 16 0 0 0 1 0 0 0 1 0 0 0 1 a.dat";
    EXPECT_EQ(open("0 Brick\r\n0 // Inner\n" + line + "\r\n").Comments, (EntryList{"// Inner\n" + line}));
    EXPECT_EQ(open("0 Brick\n0 Name: a.dat\r\n" + line + "\r\n2 24 0 0 0 1 1 1\n").Body,
              line + "\r\n2 24 0 0 0 1 1 1\r\n");
    EXPECT_EQ(open("0 Brick\r0 Name: b.dat\r1 x").Body, "1 x");
    EXPECT_EQ(header.PartName, "b.dat");
    for (const auto* lineEndsOnly : {"\r\n\r\n\r", "\n\n"}) {
        dialogs.expectMessage(Answer::Yes); // no LDraw line: opened on request
        EXPECT_EQ(open(lineEndsOnly).OldHeader, "");
        EXPECT_EQ(header.Body, "");
    }
}

TEST_F(PartFileParse, EmptyFileGivesEmptyRecordAndTheLineEndCheckReport)
{
    dialogs.expectMessage(Answer::Ok);
    const auto h = open("");
    EXPECT_EQ(h.OldHeader, "");
    ASSERT_EQ(dialogs.messages.size(), 1u);
    EXPECT_EQ(dialogs.messages[0].text,
              "Error 62 (Input past end of file) in procedure IsUnixLineEnd of Modul modUNIX");
}

TEST_F(PartFileParse, MissingFileIsReportedOnceWithItsPathAndTheSystemsReason)
{
    const std::pair<const char*, std::string> cases[] = {{"missing.dat", "Error 53 (File not found)"},
                                                         {"gone/missing.dat", "Error 76 (Path not found)"}};
    for (const auto& [name, report] : cases) {
        header.FilePath = dir.file(name);
        dialogs = ScriptedDialogs();
        dialogs.expectMessage(Answer::Ok);
        GetGlobalContent(header, dialogs, progress);
        ASSERT_EQ(dialogs.messages.size(), 1u);
        EXPECT_EQ(dialogs.messages[0].text, report + " in procedure IsUnixLineEnd of Modul modUNIX\r\n" +
                                                header.FilePath + ": No such file or directory");
    }
}

} // namespace
