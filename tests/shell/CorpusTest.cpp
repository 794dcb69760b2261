// SPDX-License-Identifier: MIT
// The real part files of the shared corpus, checked against what needs no program to know: the
// reviewed headers of chosen files, every body line kept, and a header that reads back as it was.
#include <gtest/gtest.h>

#include <algorithm>
#include <iterator>
#include <tuple>

#include "Composer.h"
#include "Corpus.h"
#include "Dialogs.h"
#include "LineEnds.h"
#include "LineReader.h"
#include "OpenDocument.h"
#include "ParseProgress.h"
#include "TempDir.h"
#include "Text.h"

namespace fs = std::filesystem;

namespace {

HeaderData opened(const std::string& path, const std::string& content)
{
    HeaderData header;
    DefaultAnswers dialogs;
    ParseProgress progress;
    OpenPartFileContent(header, path, content, dialogs, progress);
    return header;
}

// The lines after the header, found without the parser: the first line that is not a "0" line
// (or a BFC INVERTNEXT) ends the header.
std::vector<std::string> nonEmptyLinesAfterTheHeader(std::string content)
{
    if (IsUnixLineEnd(content))
        LfToCrLf(content);
    std::vector<std::string> lines;
    bool headerEnded = false;
    LineReader reader(content);
    while (!reader.atEnd()) {
        const auto line = reader.nextLine();
        const auto trimmed = TrimBlanks(line);
        const bool invertNext =
            line.rfind("0 BFC INVERTNEXT", 0) == 0 || line.rfind("0 BFC CERTIFY INVERTNEXT", 0) == 0;
        const bool metaLine = line == "0" || line.rfind("0 ", 0) == 0;
        if (!line.empty() && (!metaLine || invertNext))
            headerEnded = true;
        if (headerEnded && !trimmed.empty())
            lines.emplace_back(trimmed);
    }
    return lines;
}

bool containsInOrder(const std::string& body, const std::vector<std::string>& wanted)
{
    std::size_t next = 0;
    LineReader reader(body);
    while (!reader.atEnd() && next < wanted.size())
        if (reader.nextLine() == wanted[next])
            ++next;
    return next == wanted.size();
}

class Corpus : public ::testing::Test {
protected:
    void SetUp() override
    {
        if (files.empty())
            GTEST_SKIP() << "no corpus folder beside the project";
    }
    const std::vector<fs::path> files = CorpusPartFiles();
};

// Each file under tests/expected holds the header that saving the corpus file named by it (with
// "~" for "/") writes, as it was reviewed line by line against the original.
TEST_F(Corpus, ChosenFilesGetTheirReviewedHeaders)
{
    int compared = 0;
    for (const auto& expected : fs::directory_iterator(QUILLMARK_EXPECTED_DIR)) {
        auto name = expected.path().stem().string();
        std::replace(name.begin(), name.end(), '~', '/');
        const auto file = (fs::path(QUILLMARK_CORPUS_DIR) / name).string();
        EXPECT_EQ(ComposeHeader(opened(file, ReadBytes(file))), ReadBytes(expected.path().string())) << name;
        ++compared;
    }
    EXPECT_GE(compared, 24);
}

TEST_F(Corpus, NothingOfTheBodyIsLost)
{
    for (const auto& file : files) {
        const auto content = ReadBytes(file.string());
        EXPECT_TRUE(containsInOrder(opened(file.string(), content).Body, nonEmptyLinesAfterTheHeader(content))) << file;
    }
}

// The header a save writes, read again, gives the record it was composed from.
TEST_F(Corpus, AComposedHeaderReadsBackAsTheSameRecord)
{
    for (const auto& file : files) {
        const auto first = opened(file.string(), ReadBytes(file.string()));
        const auto again = opened(file.string(), ComposeHeader(first));
        // What reading settles once: a header without author is written with "Unknown" as the
        // author, the name read from "Name:" is lower case, and a line loses a blank at its end.
        const auto fields = [](const HeaderData& h) {
            const auto settled = [](std::string_view text) { return std::string(TrimBlanks(text)); };
            const auto settledAll = [&settled](const EntryList& list) {
                StringList texts;
                std::transform(list.begin(), list.end(), std::back_inserter(texts), settled);
                return texts;
            };
            const auto author = h.AuthorRealName.empty() ? std::string("Unknown") : h.AuthorRealName;
            return std::tuple(settled(h.PartDescription), ToLowerAscii(h.PartName), settled(author),
                              settled(h.AuthorUserName), settled(h.PartType), settled(h.UpdateTag), settled(h.License),
                              settled(h.Bfc), settled(h.Category), settledAll(h.Keywords), settledAll(h.History),
                              settledAll(h.Comments), settledAll(h.HelpLines), settledAll(h.CmdLines),
                              settledAll(h.ColorLines));
        };
        EXPECT_TRUE(fields(first) == fields(again)) << file;
    }
}

} // namespace
