#include <gtest/gtest.h>

#include "Composer.h"
#include "Corpus.h"
#include "Dialogs.h"
#include "LineEnds.h"
#include "LineReader.h"
#include "OpenDocument.h"
#include "ParseProgress.h"
#include "TempDir.h"
#include "Text.h"
#include "Words.h"

namespace {


std::string savedBytes(const std::string& path, const std::string& content)
{
    HeaderData header;
    DefaultAnswers dialogs;
    ParseProgress progress;
    OpenPartFileContent(header, path, content, dialogs, progress);
    return ComposeHeader(header) + header.Body + "\r\n";
}

// What a second save may still change: a blank at a line's end, empty lines, and the letter case
// of a name taken from the file name.
std::vector<std::string> settledForm(const std::string& bytes)
{
    std::vector<std::string> lines;
    LineReader reader(bytes);
    while (!reader.atEnd()) {
        auto line = std::string(reader.nextLine());
        line.erase(line.find_last_not_of(' ') + 1);
        if (line.rfind("0 Name: ", 0) == 0)
            line = ToLowerAscii(line);
        if (!line.empty())
            lines.push_back(line);
    }
    return lines;
}

std::vector<std::string> nonEmptyLinesAfterTheHeader(std::string content)
{
    if (IsUnixLineEnd(content))
        content = LfToCrLf(content);
    std::vector<std::string> lines;
    bool headerEnded = false;
    LineReader reader(content);
    while (!reader.atEnd()) {
        const auto line = reader.nextLine();
        const Words words(line);
        const bool invertNext = words.count() >= 3 && words.word(1) == "0" && words.word(2) == "BFC" &&
                                (words.word(3) == "INVERTNEXT" ||
                                 (words.word(3) == "CERTIFY" && words.count() >= 4 && words.word(4) == "INVERTNEXT"));
        if (!line.empty() && (words.word(1) != "0" || invertNext))
            headerEnded = true;
        const auto trimmed = TrimBlanks(line);
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

TEST(Corpus, SavingSettlesAfterOneSave)
{
    const auto files = CorpusPartFiles();
    if (files.empty())
        GTEST_SKIP() << "no corpus folder beside the project";
    for (const auto& file : files) {
        const auto once = savedBytes(file.string(), ReadBytes(file.string()));
        const auto twice = savedBytes(file.string(), once);
        EXPECT_EQ(settledForm(once), settledForm(twice)) << file;
    }
}

TEST(Corpus, NothingOfTheBodyIsLost)
{
    const auto files = CorpusPartFiles();
    if (files.empty())
        GTEST_SKIP() << "no corpus folder beside the project";
    for (const auto& file : files) {
        const auto content = ReadBytes(file.string());
        HeaderData header;
        DefaultAnswers dialogs;
        ParseProgress progress;
        OpenPartFileContent(header, file.string(), content, dialogs, progress);
        EXPECT_TRUE(containsInOrder(header.Body, nonEmptyLinesAfterTheHeader(content))) << file;
    }
}

} // namespace
