// SPDX-License-Identifier: MIT
#include "FindingPlaces.h"

#include <algorithm>
#include <array>
#include <cstring>
#include <tuple>

#include "LineEnds.h"
#include "NumberFormats.h"
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

// The first of the Tracker's line breaks in text at or after from: where it starts and its length;
// the text's size and 0 when there is none.
std::pair<std::size_t, std::size_t> nextBreak(std::string_view text, std::size_t from)
{
    for (auto i = from; i < text.size(); ++i)
        if (const auto length = BreakLength(text.substr(i)); length > 0)
            return {i, length};
    return {text.size(), 0};
}

// The line breaks the Tracker sees within a CR LF line, up to the first limit of them.
std::size_t breaksWithin(std::string_view line, std::size_t limit)
{
    std::size_t found = 0;
    for (auto [at, length] = nextBreak(line, 0); length > 0 && found < limit;
         std::tie(at, length) = nextBreak(line, at + length))
        ++found;
    return found;
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

// The number of a line's text that a finding of the number rules names.
std::string_view offendingNumber(std::string_view id, std::string_view text)
{
    const auto found = CheckNumberFormats(text);
    if (id == "numbers.decimalprecision")
        return found.tooPrecise;
    if (id == "numbers.trailingzeros")
        return found.trailingZero;
    if (id == "numbers.leadingzeros")
        return found.leadingZero;
    return {};
}

} // namespace

std::string HeaderLineKey(std::string_view line, bool first)
{
    if (first)
        return {};
    const auto keyword = Words(line).word(2);
    return keyword.empty() ? "#" : plainKeyword(keyword);
}

std::string_view HeaderLineValue(std::string_view line, bool first)
{
    return TrimTrackerLine(Words(line).joinedFrom(first ? 2 : 3));
}

FindingPlaces::FindingPlaces(std::string_view fileBytes, const HeaderData& header, const std::string& composedHeader)
    : bytes_(fileBytes), header_(header), composed_(composedHeader)
{
}

const std::vector<std::size_t>& FindingPlaces::readerStarts() const
{
    if (tablesBuilt_)
        return readerStarts_;
    tablesBuilt_ = true;
    // The parser reads the file after its byte order mark, and one with LF line ends as if each LF
    // were CR LF.
    const std::size_t first = bytes_.starts_with(Utf8ByteOrderMark) ? Utf8ByteOrderMark.size() : 0;
    const bool lineFeedsEnd = IsUnixLineEnd(bytes_.substr(first));
    readerStarts_.push_back(first);
    // CRs and LFs are looked for with memchr: the bytes between them are most of a file.
    const auto next = [this](char c, std::size_t from) {
        const auto* found = from < bytes_.size()
                                ? static_cast<const char*>(std::memchr(bytes_.data() + from, c, bytes_.size() - from))
                                : nullptr;
        return found != nullptr ? static_cast<std::size_t>(found - bytes_.data()) : bytes_.size();
    };
    auto cr = next('\r', first), lf = next('\n', first);
    while (cr < bytes_.size() || lf < bytes_.size()) {
        if (cr < lf) {
            readerStarts_.push_back(lf == cr + 1 ? cr + 2 : cr + 1);
            cr = next('\r', cr + 1);
            continue;
        }
        lineFeeds_.push_back(lf);
        if (lineFeedsEnd && (lf == 0 || bytes_[lf - 1] != '\r'))
            readerStarts_.push_back(lf + 1);
        lf = next('\n', lf + 1);
    }
    return readerStarts_;
}

std::pair<std::size_t, std::size_t> FindingPlaces::readerLine(std::size_t readerLine) const
{
    const auto& starts = readerStarts();
    if (readerLine == 0 || readerLine > starts.size())
        return {bytes_.size(), bytes_.size()};
    const auto begin = starts[readerLine - 1];
    auto end = readerLine < starts.size() ? starts[readerLine] : bytes_.size();
    // Back over the line end: CR LF, CR, or the LF of a file read with LF line ends.
    if (end > begin && bytes_[end - 1] == '\n')
        --end;
    if (end > begin && bytes_[end - 1] == '\r')
        --end;
    return {begin, end};
}

std::size_t FindingPlaces::readerLineAt(std::size_t offset) const
{
    const auto& starts = readerStarts();
    return static_cast<std::size_t>(std::upper_bound(starts.begin(), starts.end(), offset) - starts.begin());
}

FindingPlace FindingPlaces::at(std::size_t begin, std::size_t end) const
{
    readerStarts();
    const auto before = std::lower_bound(lineFeeds_.begin(), lineFeeds_.end(), begin);
    const auto lineStart = before == lineFeeds_.begin() ? 0 : *(before - 1) + 1;
    return {false, static_cast<std::size_t>(before - lineFeeds_.begin()) + 1, begin - lineStart + 1, begin, end};
}

std::size_t FindingPlaces::readerLineOfKeyword(std::string_view keyword) const
{
    if (keyword.empty()) // the description stands on the first line or nowhere
        return header_.OldHeaderLines.fileLineOf(0) == 1 ? 1 : 0;
    const auto wanted = plainKeyword(keyword);
    CrLfLines lines(header_.OldHeader);
    std::string_view line;
    for (std::size_t index = 0; lines.next(line); ++index)
        if (index > 0 && HeaderLineKey(line, false) == wanted)
            return header_.OldHeaderLines.fileLineOf(index);
    return 0;
}

FindingPlace FindingPlaces::valueOf(std::size_t readerLineNumber, std::string_view keyword) const
{
    if (readerLineNumber == 0)
        return {};
    const auto [begin, end] = readerLine(readerLineNumber);
    const auto line = bytes_.substr(begin, end - begin);
    const auto value = HeaderLineValue(line, keyword.empty());
    if (value.empty())
        return at(begin, end);
    const auto valueBegin = begin + static_cast<std::size_t>(value.data() - line.data());
    return at(valueBegin, valueBegin + value.size());
}

FindingPlace FindingPlaces::ofHeaderKeyword(std::string_view keyword) const
{
    return valueOf(readerLineOfKeyword(keyword), keyword);
}

FindingPlace FindingPlaces::ofTrackerRule(std::string_view id) const
{
    const auto family = id.substr(0, id.find('.'));
    for (const auto& rule : RuleLines) {
        if (rule.rule != id && rule.rule != family)
            continue;
        if (rule.keyword == "-")
            return {};
        if (const auto line = readerLineOfKeyword(rule.keyword); line != 0 || rule.otherwise == "-")
            return valueOf(line, rule.keyword);
        return ofHeaderKeyword(rule.otherwise);
    }
    return {};
}

// The composed line stands in the file where the same line stands, else where the first line
// with its keyword does.
FindingPlaces::RecordLine FindingPlaces::ofComposedLine(std::size_t index, std::size_t within) const
{
    if (index == 0)
        return {readerLineOfKeyword(""), within};
    const auto composedLine = lineAt(composed_, index);
    if (composedLine.empty())
        return {};
    CrLfLines lines(header_.OldHeader);
    std::string_view line;
    for (std::size_t oldIndex = 0; lines.next(line); ++oldIndex)
        if (oldIndex > 0 && line == composedLine)
            return {header_.OldHeaderLines.fileLineOf(oldIndex), within};
    return {readerLineOfKeyword(Words(composedLine).word(2)), 0};
}

FindingPlaces::RecordLine FindingPlaces::ofCheckedLine(std::size_t checkedLine) const
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
            return {}; // the line end a save adds after the body
        const auto end = std::min(piece.find(CrLf, walk_.offset), piece.size());
        const auto inner =
            breaksWithin(piece.substr(walk_.offset, end - walk_.offset), checkedLine - walk_.checkedLine);
        if (walk_.checkedLine + inner == checkedLine)
            return walk_.inBody ? RecordLine{header_.BodyLines.fileLineOf(walk_.lineIndex), inner}
                                : ofComposedLine(walk_.lineIndex, inner);
        walk_.checkedLine += inner + 1;
        walk_.offset = end + CrLf.size();
        ++walk_.lineIndex;
    }
}

FindingPlace FindingPlaces::ofLine(const TrackerFinding& finding, RecordLine line) const
{
    const auto [begin, end] = readerLine(line.readerLine);
    const auto text = bytes_.substr(begin, end - begin);
    // The line the Tracker counts within the parser's line.
    std::size_t from = 0;
    for (std::size_t k = 0; k < line.within; ++k) {
        const auto [at, length] = nextBreak(text, from);
        if (length == 0)
            break;
        from = at + length;
    }
    const auto trackerLine = text.substr(from, nextBreak(text, from).first - from);
    if (const auto number = offendingNumber(finding.id, TrimTrackerLine(trackerLine)); !number.empty()) {
        const auto numberBegin = begin + static_cast<std::size_t>(number.data() - text.data());
        return at(numberBegin, numberBegin + number.size());
    }
    return at(begin + from, begin + from + trackerLine.size());
}

FindingPlace FindingPlaces::of(const TrackerFinding& finding) const
{
    if (finding.line <= 0)
        return ofTrackerRule(finding.id);
    const auto line = ofCheckedLine(static_cast<std::size_t>(finding.line));
    return line.readerLine == 0 ? ofTrackerRule(finding.id) : ofLine(finding, line);
}
