// SPDX-License-Identifier: MIT
#include "BodyFixes.h"

#include <algorithm>
#include <functional>
#include <optional>
#include <string_view>

#include "GeometryLine.h"
#include "LineChecks.h"
#include "MetaLine.h"
#include "NumberFormats.h"
#include "NumberRewrite.h"
#include "TrackerText.h"

namespace {

bool isBlank(char c) { return c == ' ' || c == '\t'; }

std::size_t numberCountOf(int type) { return type == 2 ? 6 : type == 3 ? 9 : 12; }

// A valid geometry line, or a "0 !:" line around one, cut into its words where its blanks stand, so
// that a word can be rewritten and the blanks between the words stay as they are.
class LineWords {
public:
    // False when line is no such line, or has blanks other than spaces and TABs between its words.
    bool read(std::string_view line)
    {
        line_ = line;
        words_.clear();
        for (std::size_t i = 0; i < line.size();) {
            while (i < line.size() && isBlank(line[i]))
                ++i;
            const auto start = i;
            while (i < line.size() && !isBlank(line[i]))
                ++i;
            if (i > start)
                words_.push_back({start, i - start, std::nullopt});
        }
        first_ = words_.size() > 2 && word(0) == "0" && word(1) == "!:" ? 2 : 0;
        collapsed_ = CollapseBlanks(TrimTrackerLine(line), buffer_);
        if (!ReadGeometryLine(first_ == 0 ? collapsed_ : EmbeddedLine(collapsed_), shape_))
            return false;
        const auto count = numberCountOf(shape_.type);
        if (words_.size() < first_ + 2 + count)
            return false;
        for (std::size_t k = 0; k < count; ++k) // a type 1 line's last number may run into the file name
            if (!IsTrackerNumber(word(first_ + 2 + k)) && !(shape_.type == 1 && k + 1 == count))
                return false;
        return true;
    }

    const GeometryLine& shape() const { return shape_; }
    std::string_view collapsed() const { return collapsed_; }
    std::string_view colour() const { return word(first_ + 1); }

    // How many numbers the rewrite changed.
    int rewriteNumbers(const std::function<std::string(std::string_view)>& rewrite)
    {
        int changed = 0;
        for (std::size_t k = first_ + 2; k < first_ + 2 + numberCountOf(shape_.type); ++k)
            if (IsTrackerNumber(word(k)))
                changed += (words_[k].replacement = rewrite(word(k))) != word(k) ? 1 : 0;
        return changed;
    }
    void setColour(std::string colour) { words_[first_ + 1].replacement = std::move(colour); }

    // The line with its rewritten words.
    std::string text() const
    {
        std::string text;
        std::size_t at = 0;
        for (const auto& w : words_) {
            text.append(line_.substr(at, w.start - at));
            text.append(w.replacement ? std::string_view(*w.replacement) : line_.substr(w.start, w.length));
            at = w.start + w.length;
        }
        return text.append(line_.substr(at));
    }

private:
    struct Word {
        std::size_t start, length;
        std::optional<std::string> replacement;
    };
    std::string_view word(std::size_t k) const { return line_.substr(words_[k].start, words_[k].length); }

    std::string_view line_, collapsed_;
    std::string buffer_;
    std::vector<Word> words_;
    std::size_t first_ = 0;
    GeometryLine shape_;
};

// Hands each line of body with its number in the file to fix, and puts in what fix returns.
void forEachLine(std::string& body, int firstLine,
                 const std::function<std::optional<std::string>(std::string_view, int)>& fix)
{
    std::string fixed;
    std::size_t copied = 0;
    int number = firstLine;
    for (std::size_t start = 0; start <= body.size(); ++number) {
        const auto end = std::min(body.find("\r\n", start), body.size());
        if (auto line = fix(std::string_view(body).substr(start, end - start), number)) {
            fixed.append(body, copied, start - copied).append(*line);
            copied = end;
        }
        start = end + 2;
    }
    if (copied == 0)
        return;
    fixed.append(body, copied);
    body = std::move(fixed);
}

// The word of text that breaks the rule of fix, or an empty one.
std::string_view offendingWord(std::string_view text, NumberFix fix)
{
    const auto found = CheckNumberFormats(text);
    switch (fix) {
    case NumberFix::TrailingZeros: return found.trailingZero;
    case NumberFix::LeadingZeros: return found.leadingZero;
    case NumberFix::DecimalPrecision: return found.tooPrecise;
    }
    return {};
}

std::function<std::string(std::string_view)> rewriteOf(NumberFix fix)
{
    switch (fix) {
    case NumberFix::TrailingZeros: return WithoutTrailingZeros;
    case NumberFix::LeadingZeros: return WithoutLeadingZeros;
    case NumberFix::DecimalPrecision: break;
    }
    return RoundedToFiveDecimals;
}

std::vector<std::string> geometryIds(const GeometryLine& shape)
{
    Findings findings;
    CheckLineGeometry(shape, 0, findings);
    std::vector<std::string> ids;
    for (const auto& finding : findings.take())
        ids.push_back(finding.id);
    return ids;
}

// The geometry finding that the rewritten line has and the line as it stands has not.
std::optional<std::string> geometryMadeBy(const LineWords& before, const std::string& rewritten)
{
    LineWords after;
    if (!after.read(rewritten))
        return "line.invalid";
    const auto had = geometryIds(before.shape());
    for (const auto& id : geometryIds(after.shape()))
        if (std::find(had.begin(), had.end(), id) == had.end())
            return id;
    return std::nullopt;
}

std::string lineNote(std::size_t number, const std::string& why)
{
    return "line " + std::to_string(number) + ": " + why;
}

// Why a finding outlives the rewrite of the line's numbers: it is about a word that is no number.
std::string whyLeft(const LineWords& line, std::string_view word)
{
    std::string quoted = "\"";
    quoted.append(word).append("\"");
    if (word == line.colour())
        return "the colour code " + quoted + " is kept as it is";
    return quoted + " is no number of the line" + (line.shape().type == 1 ? " (it is in the file name)" : "");
}

} // namespace

std::optional<std::string> FixLineNumbers(std::string_view text, NumberFix fix, std::size_t number, FixNote& note)
{
    LineWords line;
    if (!line.read(text) || offendingWord(line.collapsed(), fix).empty())
        return std::nullopt;
    const auto numbers = line.rewriteNumbers(rewriteOf(fix));
    auto rewritten = line.text();
    if (fix == NumberFix::DecimalPrecision)
        if (const auto made = geometryMadeBy(line, rewritten)) {
            note.left.push_back(lineNote(number, "rounding would make it " + *made));
            return std::nullopt;
        }
    LineWords after;
    after.read(rewritten);
    if (const auto word = offendingWord(after.collapsed(), fix); !word.empty())
        note.left.push_back(lineNote(number, whyLeft(after, word)));
    else
        ++note.fixed;
    note.numbers += numbers;
    return rewritten == text ? std::nullopt : std::optional(std::move(rewritten));
}

std::optional<std::string> FixLineColour(std::string_view text, FixNote& note)
{
    LineWords line;
    if (!line.read(text) || (line.shape().type != 2 && line.shape().type != 5) ||
        (!line.shape().directColour && line.shape().colour == 24))
        return std::nullopt;
    line.setColour("24");
    ++note.fixed;
    ++note.numbers;
    return line.text();
}

FixNote FixNumbers(std::string& body, NumberFix fix, int firstLine)
{
    FixNote note;
    forEachLine(body, firstLine, [&](std::string_view text, int number) {
        return FixLineNumbers(text, fix, static_cast<std::size_t>(number), note);
    });
    return note;
}

FixNote FixLineColours(std::string& body, int firstLine)
{
    FixNote note;
    forEachLine(body, firstLine, [&](std::string_view text, int) { return FixLineColour(text, note); });
    return note;
}
