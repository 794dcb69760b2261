// SPDX-License-Identifier: MIT
#include "Parser.h"

#include <array>
#include <optional>

#include "Dates.h"
#include "Dialogs.h"
#include "ErrorReport.h"
#include "InPlaceBody.h"
#include "LineEnds.h"
#include "ParseProgress.h"
#include "PartFile.h"
#include "Text.h"
#include "TextFile.h"
#include "Words.h"

namespace {

const Procedure IsUnixLineEndProcedure{"IsUnixLineEnd", OwnerKind::Modul, "modUNIX"};
const Procedure GetGlobalContentProcedure{"GetGlobalContent", OwnerKind::Modul, "modQuillmark"};

// The keywords of the header lines the parser knows; a two-word line with one of these carries
// nothing and is dropped.
constexpr std::array<std::string_view, 23> KnownKeywords = {
    "Name:",      "Author:",  "CATEGORY", "!CATEGORY",  "BFC",       "COLOR",    "Unofficial", "unofficial",
    "UNOFFICIAL", "Original", "original", "!LDRAW_ORG", "LDRAW_ORG", "!LDRAW",   "!CMDLINE",   "CMDLINE",
    "!KEYWORDS",  "KEYWORDS", "!HELP",    "!LICENSE",   "HISTORY",   "!HISTORY", "//"};

template <std::size_t N>
bool isOneOf(std::string_view word, const std::array<std::string_view, N>& forms)
{
    for (const auto form : forms)
        if (word == form)
            return true;
    return false;
}

bool isOneOf(std::string_view word, std::initializer_list<std::string_view> forms)
{
    for (const auto form : forms)
        if (word == form)
            return true;
    return false;
}

// A header of millions of lines would have its old-header text and its lists grow by doubling,
// each step holding the old and the new buffer at once. Once they are large they take at once the
// room the rest of the text could still fill; room never written to is never touched and costs
// address space only.
constexpr std::size_t LargeText = std::size_t{1024} * 1024;
constexpr std::size_t LargeList = 4096;
constexpr std::size_t ShortestListLine = 6; // "0 // x"

void makeRoom(std::string& text, std::size_t adding, std::size_t restOfText)
{
    if (text.size() + adding > text.capacity() && text.size() >= LargeText)
        text.reserve(text.size() + adding + restOfText);
}

void makeRoom(EntryList& list, std::size_t adding, std::size_t restOfText)
{
    if (list.size() >= LargeList && !list.fits(adding))
        list.reserve(list.size() + 1 + restOfText / ShortestListLine, list.textSize() + adding + restOfText);
}

void appendLine(std::string& text, std::string_view line)
{
    if (!text.empty())
        text += CrLf;
    text += line;
}

class HeaderParser {
public:
    HeaderParser(HeaderData& header, InPlaceBody& body) : h_(header), body_(body) {}

    void classify(std::string_view line, std::size_t lineNumber);
    bool headerEnded() const { return headerEnded_; }

private:
    void toBody(std::string_view line)
    {
        h_.BodyLines.add(lineNumber_);
        body_.keep(line);
    }
    // The rest of the body, from this line on, is numbered where the parse goes on.
    void endHeader(std::string_view line)
    {
        headerEnded_ = true;
        body_.keep(line);
    }
    std::string_view word(std::size_t position) const { return words_.word(position); }
    std::size_t wordCount() const { return words_.count(); }
    std::string_view joinedFrom(std::size_t k) const { return words_.joinedFrom(k); }
    // The entry's pieces go straight into the list: a line of many megabytes is never copied
    // into an entry of its own first.
    void addEntry(EntryList& list, std::initializer_list<std::string_view> pieces)
    {
        std::size_t size = 0;
        for (const auto piece : pieces)
            size += piece.size();
        makeRoom(list, size, body_.remainingBytes());
        list.pushPieces(pieces);
    }

    // A date alone makes an entry without a blank after it, which would be written at the end of
    // the history line and taken away again when the file is read back.
    void addHistoryEntry(std::string_view date, std::string_view text)
    {
        if (text.empty())
            addEntry(h_.History, {date});
        else
            addEntry(h_.History, {date, " ", text});
    }

    void takeDescription(std::string_view line);
    void takeKeywordLine(std::string_view line);
    void takeAuthor();
    void takeBfc(std::string_view line);
    void takePartType();
    void takeComment();
    void takeDatedOrBody(std::string_view line);

    HeaderData& h_;
    InPlaceBody& body_;
    bool headerEnded_ = false;
    std::size_t lineNumber_ = 0;
    Words words_;
};

void HeaderParser::classify(std::string_view line, std::size_t lineNumber)
{
    if (line.empty())
        return;
    lineNumber_ = lineNumber;
    words_ = Words(line);
    if (word(1) != "0") {
        endHeader(line);
        return;
    }
    makeRoom(h_.OldHeader, line.size() + CrLf.size(), body_.remainingBytes());
    appendLine(h_.OldHeader, line);
    h_.OldHeaderLines.add(lineNumber);
    if (lineNumber == 1) {
        takeDescription(line);
        return;
    }
    if (wordCount() >= 3)
        takeKeywordLine(line);
    else if (wordCount() == 2 && !word(2).empty() && !isOneOf(word(2), KnownKeywords))
        takeDatedOrBody(line);
}

void HeaderParser::takeDescription(std::string_view line)
{
    const auto trimmed = TrimBlanks(line);
    h_.PartDescription = trimmed.size() < 3 ? std::string() : std::string(trimmed.substr(2));
    h_.NeedsWork = ContainsIgnoreCase(h_.PartDescription, "need") && ContainsIgnoreCase(h_.PartDescription, "work");
}

void HeaderParser::takeKeywordLine(std::string_view line)
{
    const auto keyword = word(2);
    if (keyword == "Name:") {
        if (!word(3).empty()) // an empty name is written back as a bare "Name:", which says nothing
            h_.PartName = ToLowerAscii(word(3));
    } else if (keyword == "Author:")
        takeAuthor();
    else if (isOneOf(keyword, {"CATEGORY", "!CATEGORY"}))
        h_.Category = joinedFrom(3);
    else if (keyword == "BFC")
        takeBfc(line);
    else if (keyword == "COLOR")
        addEntry(h_.ColorLines, {line});
    else if (isOneOf(keyword, {"Unofficial", "unofficial", "UNOFFICIAL"})) {
        if (isOneOf(word(3), {"Part", "Model", "part", "model", "element", "Element", "ELEMENT"}))
            h_.PartType = "Unofficial_Part";
        else if (isOneOf(word(3), {"Subpart", "subpart", "SUBPART"}))
            h_.PartType = "Unofficial_Subpart";
    } else if (isOneOf(keyword, {"Original", "original"})) {
        if (wordCount() >= 4 && isOneOf(word(3), {"LDRAW", "LDraw"}) && isOneOf(word(4), {"Part", "part"}))
            h_.PartType = "Part";
    } else if (isOneOf(keyword, {"!LDRAW_ORG", "LDRAW_ORG", "!LDRAW"}))
        takePartType();
    else if (isOneOf(keyword, {"!CMDLINE", "CMDLINE"}))
        addEntry(h_.CmdLines, {joinedFrom(3)});
    else if (isOneOf(keyword, {"!KEYWORDS", "KEYWORDS"}))
        addEntry(h_.Keywords, {joinedFrom(3)});
    else if (keyword == "!HELP")
        addEntry(h_.HelpLines, {joinedFrom(3)});
    else if (keyword == "!LICENSE")
        h_.License = joinedFrom(3);
    else if (isOneOf(keyword, {"HISTORY", "!HISTORY"}))
        addEntry(h_.History, {joinedFrom(3)});
    else if (keyword == "//")
        takeComment();
    else
        takeDatedOrBody(line);
}

// "0 Author: Jane Doe [jdoe]": the words up to the bracketed user name are the real name.
void HeaderParser::takeAuthor()
{
    h_.ParsedRealName.clear();
    for (std::size_t position = 3; position <= wordCount(); ++position) {
        const auto current = word(position);
        if (h_.ParsedRealName.empty()) {
            h_.ParsedRealName = current;
            continue;
        }
        if (!current.empty() && (current[0] == '[' || current[0] == '<' || current[0] == '('))
            h_.AuthorUserName = current.size() < 3 ? std::string() : std::string(current.substr(1, current.size() - 2));
        else
            h_.ParsedRealName.append(" ").append(current);
        const auto at = h_.AuthorUserName.find('@');
        if (at != std::string::npos)
            h_.AuthorUserName.resize(at);
    }
}

// The statement is judged by its words as the composer writes them back (extra blanks between them
// gone), so that the line means the same when the saved file is read again.
void HeaderParser::takeBfc(std::string_view line)
{
    const auto statement = joinedFrom(3);
    const Words words(statement);
    if (words.word(1) == "INVERTNEXT" || (words.word(1) == "CERTIFY" && words.word(2) == "INVERTNEXT")) {
        endHeader(line);
        return;
    }
    if (statement != "CERTIFY")
        h_.Bfc = statement;
}

// "0 !LDRAW_ORG Part UPDATE 2004-01": the words before "UPDATE" are the type, the next the tag.
void HeaderParser::takePartType()
{
    h_.PartType.clear();
    for (std::size_t position = 3; position <= wordCount(); ++position) {
        const auto current = word(position);
        if (h_.PartType.empty()) {
            h_.PartType = current;
        } else if (current == "UPDATE") {
            if (position < wordCount())
                h_.UpdateTag = word(position + 1);
            return;
        } else {
            h_.PartType.append(" ").append(current);
        }
    }
}

void HeaderParser::takeComment()
{
    if (const auto date = DateOfWord(word(3)))
        addHistoryEntry(*date, joinedFrom(4));
    else
        addEntry(h_.Comments, {joinedFrom(2)});
}

// An old history line without keyword ("0 2004-03-12 [jdoe] fixed"), or a meta line the header
// does not know, which stays in the body while the header goes on.
void HeaderParser::takeDatedOrBody(std::string_view line)
{
    if (const auto date = DateOfWord(word(2)))
        addHistoryEntry(*date, joinedFrom(3));
    else
        toBody(line);
}

void clearParsedContent(HeaderData& header)
{
    header.OldHeader.clear();
    header.Body.clear();
    header.OldHeaderLines.clear();
    header.BodyLines.clear();
    header.HelpLines.clear();
    header.CmdLines.clear();
    header.Keywords.clear();
    header.Comments.clear();
    header.History.clear();
    header.ColorLines.clear();
}

class BusyPointer {
public:
    explicit BusyPointer(ParseProgress& progress) : progress_(progress) { progress_.setBusy(true); }
    ~BusyPointer() { progress_.setBusy(false); }
    BusyPointer(const BusyPointer&) = delete;
    BusyPointer& operator=(const BusyPointer&) = delete;

private:
    ParseProgress& progress_;
};

// Text that holds no LDraw line opens only when the user says so. An empty or a binary file is
// left to the reports that it gets anyway.
bool mayOpenAsPart(std::string_view content, const std::string& path, Dialogs& dialogs)
{
    if (content.empty() || LooksBinary(content) || LooksLikeLDraw(content))
        return true;
    return dialogs.message({path + " does not look like an LDraw file. Open it anyway?", ProgramTitle, Buttons::YesNo,
                            Icon::Question, Answer::No}) == Answer::Yes;
}

} // namespace

void ParseHeaderText(HeaderData& header, std::string text, ParseProgress& progress)
{
    clearParsedContent(header);
    BusyPointer busy(progress);
    InPlaceBody lines(text);
    std::size_t linesRead = 0;
    std::size_t nextReport = 0;
    const auto nextLine = [&]() {
        if (linesRead >= nextReport) {
            progress.lineProgress(linesRead);
            progress.processEvents();
            nextReport = linesRead + 10;
        }
        ++linesRead;
        return lines.nextLine();
    };
    HeaderParser parser(header, lines);
    const auto finish = [&header, &lines]() {
        header.Encoding = lines.utf8() ? TextEncoding::Utf8 : TextEncoding::Latin1;
        header.Body = lines.take();
    };
    try {
        while (!lines.atEnd() && !parser.headerEnded()) {
            const auto line = nextLine();
            parser.classify(line, linesRead);
        }
        // The rest of the body follows the file line for line from its first line on: the line
        // that ended the header, or the first after it that the body keeps.
        bool restNumbered = false;
        const auto numberRest = [&] {
            if (!restNumbered && parser.headerEnded() && !lines.bodyEmpty()) {
                header.BodyLines.add(linesRead);
                restNumbered = true;
            }
        };
        numberRest();
        while (!lines.atEnd()) {
            lines.keep(nextLine());
            numberRest();
            linesRead += lines.keepPlainLines();
        }
    } catch (...) {
        finish(); // what the lines before the failure gave
        throw;
    }
    finish();
}

bool ParsePartFileContent(HeaderData& header, std::string content, Dialogs& dialogs, ParseProgress& progress)
{
    EnsureTextFile(content, header.FilePath);
    // Editors that put a byte order mark before the first line would otherwise hide the whole
    // header in the body, and a save would write a second, empty header above it.
    header.ByteOrderMark = content.starts_with(Utf8ByteOrderMark);
    if (header.ByteOrderMark)
        content.erase(0, Utf8ByteOrderMark.size());
    const bool empty = content.empty();
    if (empty)
        ReportError(dialogs, InputPastEndOfFileError(), IsUnixLineEndProcedure);
    if (IsUnixLineEnd(content)) {
        LfToCrLf(content);
        content += CrLf;
    }
    ParseHeaderText(header, std::move(content), progress);
    return !empty;
}

bool GetGlobalContent(HeaderData& header, Dialogs& dialogs, ParseProgress& progress, const PartCheck& beforeRead)
{
    progress.processEvents();
    std::shared_ptr<OpenPart> part;
    std::optional<FileBytes> content;
    try {
        part = OpenPart::openPath(header.FilePath);
        if (beforeRead)
            beforeRead(*part);
        content.emplace(*part, TextFileCheck(header.FilePath));
    } catch (const NotTextFileError& notText) {
        dialogs.message({notText.what(), ProgramTitle, Buttons::Ok, Icon::Exclamation, Answer::Ok});
        return false;
    } catch (const QmError& error) {
        // One box for one failure, naming the file and the system's reason.
        ReportError(dialogs, error, IsUnixLineEndProcedure);
        return false;
    }
    try {
        if (!mayOpenAsPart(content->view(), header.FilePath, dialogs) ||
            !ParsePartFileContent(header, content->takeBytes(), dialogs, progress))
            return false;
        header.Part = std::move(part);
        header.ReadStamp = content->stamp();
        return true;
    } catch (const std::exception& failure) {
        ReportError(dialogs, ErrorOf(failure), GetGlobalContentProcedure);
    }
    return false;
}
