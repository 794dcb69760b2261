// SPDX-License-Identifier: MIT
#include "FileLinePlaces.h"

#include <algorithm>
#include <array>

#include "Text.h"
#include "TrackerText.h"
#include "Words.h"

namespace {

// The parser takes "!KEYWORDS" and "KEYWORDS", "!LDRAW_ORG", "LDRAW_ORG" and "!LDRAW" alike.
std::string plainKeyword(std::string_view word)
{
    if (word.starts_with('!'))
        word.remove_prefix(1);
    auto plain = ToUpperAscii(word);
    return plain == "LDRAW" ? "LDRAW_ORG" : plain;
}

// The lines of a CR LF text, one at a time.
class CrLfLines {
public:
    explicit CrLfLines(std::string_view text) : text_(text) {}
    bool next(std::string_view& line)
    {
        if (position_ > text_.size())
            return false;
        const auto end = std::min(text_.find(CrLf, position_), text_.size());
        line = text_.substr(position_, end - position_);
        position_ = end + CrLf.size();
        return true;
    }

private:
    std::string_view text_;
    std::size_t position_ = 0;
};

std::string_view lineAt(std::string_view text, std::size_t index)
{
    CrLfLines lines(text);
    std::string_view line;
    for (std::size_t i = 0; lines.next(line); ++i)
        if (i == index)
            return line;
    return {};
}

struct Breaks {
    std::size_t all = 0, lineFeeds = 0;
};

// The line breaks the Tracker sees within a CR LF line, up to the first limit of them; LFs among
// them are line ends for an editor too.
Breaks breaksWithin(std::string_view line, std::size_t limit)
{
    Breaks found;
    for (std::size_t i = 0; i < line.size() && found.all < limit;) {
        const auto length = BreakLength(line.substr(i));
        if (length == 0) {
            ++i;
            continue;
        }
        ++found.all;
        found.lineFeeds += line[i] == '\n' ? 1 : 0;
        i += length;
    }
    return found;
}

// Adds to table each line of the CR LF text that holds lone LFs, from the parser's line from on.
void noteLineFeeds(std::string_view text, const FileLines& lines, std::size_t from,
                   std::vector<std::pair<std::size_t, std::size_t>>& table, std::size_t& total)
{
    std::size_t index = 0;
    for (auto at = text.find('\n'); at != std::string_view::npos; at = text.find('\n', at + 1)) {
        if (at > 0 && text[at - 1] == '\r') {
            ++index;
            continue;
        }
        const auto readerLine = lines.fileLineOf(index);
        if (readerLine < from)
            continue;
        ++total;
        if (!table.empty() && table.back().first == readerLine)
            table.back().second = total;
        else
            table.emplace_back(readerLine, total);
    }
}

// The header line each family of the Tracker's rules is about, by its keyword ("" for the
// description's line), and where to look when the file lacks that line.
struct RuleLine {
    std::string_view rule; // an id up to its ".", or a whole id
    std::string_view keyword;
    std::string_view otherwise = "-"; // "-": no other line
};
constexpr std::array<RuleLine, 11> RuleLines = {{
    {"license", "!LICENSE"},
    {"name", "Name:"},
    {"description", ""},
    {"warning.descriptionnumbers", ""},
    {"history", "!HISTORY"},
    {"category", "!CATEGORY", ""},
    {"warning.minifigcategory", "!CATEGORY", ""},
    {"keywords", "!KEYWORDS"},
    {"type", "!LDRAW_ORG"},
    {"bfc", "BFC"},
    {"warning.previewinvalid", "!PREVIEW"},
}};

} // namespace

FileLinePlaces::FileLinePlaces(const HeaderData& header, const std::string& composedHeader)
    : header_(header), composed_(composedHeader)
{
}

std::size_t FileLinePlaces::lineFeedsBefore(std::size_t readerLine) const
{
    if (!lineFeeds_) {
        auto& table = lineFeeds_.emplace();
        std::size_t total = 0;
        noteLineFeeds(header_.OldHeader, header_.OldHeaderLines, 0, table, total);
        // The body's lines up to the last header line are header lines the header passed on.
        const auto& headerLines = header_.OldHeaderLines;
        const auto lastHeaderLine = headerLines.size() == 0 ? 0 : headerLines.fileLineOf(headerLines.size() - 1);
        noteLineFeeds(header_.Body, header_.BodyLines, lastHeaderLine + 1, table, total);
    }
    const auto after = std::lower_bound(lineFeeds_->begin(), lineFeeds_->end(), readerLine,
                                        [](const auto& entry, std::size_t line) { return entry.first < line; });
    return after == lineFeeds_->begin() ? 0 : (after - 1)->second;
}

std::size_t FileLinePlaces::editorLine(std::size_t readerLine, std::size_t linesWithin) const
{
    return readerLine == 0 ? 0 : readerLine + lineFeedsBefore(readerLine) + linesWithin;
}

std::size_t FileLinePlaces::ofOldHeaderLine(std::size_t index, std::size_t linesWithin) const
{
    return editorLine(header_.OldHeaderLines.fileLineOf(index), linesWithin);
}

std::size_t FileLinePlaces::ofHeaderKeyword(std::string_view keyword) const
{
    if (keyword.empty()) // the description stands on the first line or nowhere
        return header_.OldHeaderLines.fileLineOf(0) == 1 ? 1 : 0;
    const auto wanted = plainKeyword(keyword);
    CrLfLines lines(header_.OldHeader);
    std::string_view line;
    for (std::size_t index = 0; lines.next(line); ++index)
        if (index > 0 && plainKeyword(Words(line).word(2)) == wanted)
            return ofOldHeaderLine(index, 0);
    return 0;
}

// The composed line stands in the file where the same line stands, else where the first line
// with its keyword does.
std::size_t FileLinePlaces::ofComposedLine(std::size_t index, std::size_t linesWithin) const
{
    if (index == 0)
        return ofHeaderKeyword("") + linesWithin;
    const auto composedLine = lineAt(composed_, index);
    if (composedLine.empty())
        return 0;
    CrLfLines lines(header_.OldHeader);
    std::string_view line;
    for (std::size_t oldIndex = 0; lines.next(line); ++oldIndex)
        if (oldIndex > 0 && line == composedLine)
            return ofOldHeaderLine(oldIndex, linesWithin);
    return ofHeaderKeyword(Words(composedLine).word(2));
}

std::size_t FileLinePlaces::ofCheckedLine(std::size_t checkedLine) const
{
    if (checkedLine < walk_.checkedLine)
        walk_ = {};
    for (;;) {
        const std::string_view piece = walk_.inBody ? std::string_view(header_.Body) : composed_;
        if (!walk_.inBody && walk_.offset >= piece.size()) {
            walk_ = {true, 0, 0, walk_.checkedLine}; // the body goes on where the header's last CR LF ends
            continue;
        }
        if (walk_.offset > piece.size())
            return 0; // the line end a save adds after the body
        const auto end = std::min(piece.find(CrLf, walk_.offset), piece.size());
        const auto inner =
            breaksWithin(piece.substr(walk_.offset, end - walk_.offset), checkedLine - walk_.checkedLine);
        if (walk_.checkedLine + inner.all == checkedLine)
            return walk_.inBody ? editorLine(header_.BodyLines.fileLineOf(walk_.lineIndex), inner.lineFeeds)
                                : ofComposedLine(walk_.lineIndex, inner.lineFeeds);
        walk_.checkedLine += inner.all + 1;
        walk_.offset = end + CrLf.size();
        ++walk_.lineIndex;
    }
}
std::size_t FileLinePlaces::ofTrackerRule(std::string_view id) const
{
    const auto family = id.substr(0, id.find('.'));
    for (const auto& rule : RuleLines) {
        if (rule.rule != id && rule.rule != family)
            continue;
        if (rule.keyword == "-")
            return 0;
        const auto line = ofHeaderKeyword(rule.keyword);
        return line != 0 || rule.otherwise == "-" ? line : ofHeaderKeyword(rule.otherwise);
    }
    return 0;
}
