// SPDX-License-Identifier: MIT
#include "FileRepairs.h"

#include <algorithm>
#include <array>
#include <map>
#include <tuple>

#include "Composer.h"
#include "FindingPlaces.h"
#include "Text.h"

namespace {

// The Tracker's order of the header lines, by key; a line the file lacks is added after the last
// line of its own key or of one before it.
constexpr std::array<std::string_view, 11> HeaderOrder = {"",    "NAME:",    "AUTHOR:",  "LDRAW_ORG", "LICENSE", "HELP",
                                                          "BFC", "CATEGORY", "KEYWORDS", "CMDLINE",   "HISTORY"};
// The keys a header has one line of at most.
constexpr std::array<std::string_view, 7> SingleLines = {"",        "NAME:", "AUTHOR:", "LDRAW_ORG",
                                                         "LICENSE", "BFC",   "CATEGORY"};
constexpr std::string_view HistoryKey = "HISTORY";

std::size_t rankOf(std::string_view key)
{
    return static_cast<std::size_t>(std::find(HeaderOrder.begin(), HeaderOrder.end(), key) - HeaderOrder.begin());
}

bool isSingle(std::string_view key)
{
    return std::find(SingleLines.begin(), SingleLines.end(), key) != SingleLines.end();
}

// The non-blank lines of a composed header by key, in their order.
using KeyedLines = std::map<std::string, std::vector<std::string>>;

KeyedLines keyedLines(std::string_view composed)
{
    KeyedLines lines;
    bool first = true;
    for (std::size_t at = 0; at < composed.size();) {
        const auto end = std::min(composed.find(CrLf, at), composed.size());
        const auto line = composed.substr(at, end - at);
        if (!line.empty())
            lines[HeaderLineKey(line, first)].emplace_back(line);
        first = false;
        at = end + CrLf.size();
    }
    return lines;
}

std::set<std::string> keysChanged(const KeyedLines& before, const KeyedLines& after)
{
    std::set<std::string> keys;
    for (const auto& [key, lines] : before)
        if (!after.contains(key) || after.at(key) != lines)
            keys.insert(key);
    for (const auto& [key, lines] : after)
        if (!before.contains(key))
            keys.insert(key);
    return keys;
}

std::string shownKey(const std::string& key) { return key.empty() ? "description" : key; }

// Writes the changes of the composed header's lines as edits of the file's own header lines.
class HeaderEditor {
public:
    HeaderEditor(const FindingPlaces& places, const HeaderData& read) : places_(places)
    {
        std::size_t index = 0;
        for (std::size_t at = 0; at <= read.OldHeader.size(); ++index) {
            const auto end = std::min(read.OldHeader.find(CrLf, at), read.OldHeader.size());
            const auto line = std::string_view(read.OldHeader).substr(at, end - at);
            if (index > 0 || !line.empty())
                lines_.push_back({HeaderLineKey(line, index == 0), read.OldHeaderLines.fileLineOf(index)});
            at = end + CrLf.size();
        }
    }

    // The edits that turn the file's lines of key from before into after; false when the change
    // is none an edit of single lines makes.
    bool change(const std::string& key, const std::vector<std::string>& before, const std::vector<std::string>& after,
                std::vector<std::pair<TextEdit, std::size_t>>& edits, std::vector<std::size_t>& lines) const
    {
        if (isSingle(key)) {
            const auto* own = lineOf(key, false);
            if (own != nullptr && !after.empty())
                edits.emplace_back(replaced(*own, after.front(), key.empty(), lines), 0);
            else if (own != nullptr)
                edits.emplace_back(removed(*own, lines), 0);
            else if (!after.empty())
                edits.emplace_back(added(key, after.front(), lines), rankOf(key) * 100);
            return true;
        }
        if (key != HistoryKey || after.size() < before.size() ||
            !std::equal(before.begin(), before.end(), after.begin()))
            return false;
        for (auto k = before.size(); k < after.size(); ++k)
            edits.emplace_back(added(key, after[k], lines), rankOf(key) * 100 + k);
        return true;
    }

private:
    struct DiskLine {
        std::string key;
        std::size_t readerLine;
    };

    // The first (or last) line of the file's header with the key.
    const DiskLine* lineOf(const std::string& key, bool last) const
    {
        const DiskLine* found = nullptr;
        for (const auto& line : lines_)
            if (line.key == key && (found == nullptr || last))
                found = &line;
        return found;
    }

    TextEdit replaced(const DiskLine& line, std::string_view newLine, bool first, std::vector<std::size_t>& lines) const
    {
        const auto [begin, end] = places_.readerLine(line.readerLine);
        const auto text = places_.bytes().substr(begin, end - begin);
        lines.push_back(places_.at(begin, end).line);
        const auto value = HeaderLineValue(text, first);
        if (value.empty())
            return {begin, end, std::string(newLine)};
        const auto valueBegin = begin + static_cast<std::size_t>(value.data() - text.data());
        return {valueBegin, valueBegin + value.size(), std::string(HeaderLineValue(newLine, first))};
    }

    TextEdit removed(const DiskLine& line, std::vector<std::size_t>& lines) const
    {
        const auto [begin, end] = places_.readerLine(line.readerLine);
        lines.push_back(places_.at(begin, end).line);
        return {begin, places_.readerLine(line.readerLine + 1).first, {}};
    }

    // The new line goes after the last line of its key or of one before it in the Tracker's order,
    // with that line's own line end.
    TextEdit added(const std::string& key, std::string_view newLine, std::vector<std::size_t>& lines) const
    {
        const DiskLine* anchor = nullptr;
        for (const auto& line : lines_)
            if (rankOf(line.key) <= rankOf(key))
                anchor = &line;
        if (anchor == nullptr) {
            const auto start = places_.readerLine(1).first;
            lines.push_back(places_.at(start, start).line);
            return {start, start, std::string(newLine) + lineEnd(places_.readerLine(1).second)};
        }
        const auto end = places_.readerLine(anchor->readerLine).second;
        lines.push_back(places_.at(end, end).line + 1);
        return {end, end, lineEnd(end) + std::string(newLine)};
    }

    // The line end at offset, else the file's first, else CR LF.
    std::string lineEnd(std::size_t offset) const
    {
        const auto bytes = places_.bytes();
        auto at = offset < bytes.size() && (bytes[offset] == '\r' || bytes[offset] == '\n')
                      ? offset
                      : std::min(bytes.find_first_of("\r\n"), bytes.size());
        if (at == bytes.size())
            return std::string(CrLf);
        if (bytes[at] == '\n')
            return "\n";
        return at + 1 < bytes.size() && bytes[at + 1] == '\n' ? std::string(CrLf) : "\r";
    }

    const FindingPlaces& places_;
    std::vector<DiskLine> lines_;
};

// The findings that stop the Tracker's other rules, so that no repair is sure.
bool stopsTheRules(const TrackerFinding& finding) { return finding.id == "missing" || finding.id == "authorinvalid"; }

void addLine(std::vector<std::size_t>& lines, std::size_t line)
{
    if (lines.empty() || lines.back() != line)
        lines.push_back(line);
}

// The repairs of body lines, each on the lines that have its finding.
void repairBodyLines(const FindingPlaces& places, const std::vector<TrackerFinding>& findings,
                     const std::set<std::string>& chosen, std::vector<std::pair<TextEdit, std::size_t>>& edits,
                     FileRepairs& result)
{
    std::map<std::size_t, std::set<std::string>> lineRepairs; // by the parser's line
    for (const auto& finding : findings)
        if (chosen.contains(finding.id) && finding.line > 0)
            lineRepairs[places.readerLineAt(places.of(finding).begin)].insert(finding.id);
    std::map<std::string, FileRepair> repairs;
    for (const auto& [readerLine, ids] : lineRepairs) {
        const auto [begin, end] = places.readerLine(readerLine);
        const auto original = places.bytes().substr(begin, end - begin);
        const auto line = places.at(begin, end).line;
        std::string text(original);
        for (const auto& fix : TrackerFixes()) {
            if (fix.repairLine == nullptr || !ids.contains(fix.id))
                continue;
            auto& repair = repairs[fix.id];
            FixNote note;
            if (auto rewritten = fix.repairLine(text, line, note)) {
                text = std::move(*rewritten);
                addLine(repair.lines, line);
            }
            repair.fixed += note.fixed;
            repair.numbers += note.numbers;
            repair.left.insert(repair.left.end(), note.left.begin(), note.left.end());
        }
        if (text != original)
            edits.push_back({{begin, end, std::move(text)}, 0});
    }
    for (const auto& fix : TrackerFixes())
        if (const auto found = repairs.find(fix.id); found != repairs.end()) {
            found->second.id = fix.id;
            result.repairs.push_back(std::move(found->second));
        }
}

} // namespace

std::string ApplyEdits(std::string_view bytes, const std::vector<TextEdit>& edits)
{
    std::string result;
    std::size_t copied = 0;
    for (const auto& edit : edits) {
        result.append(bytes.substr(copied, edit.begin - copied)).append(edit.replacement);
        copied = edit.end;
    }
    return result.append(bytes.substr(copied));
}

FileRepairs RepairsOf(std::string_view bytes, const HeaderData& read, const HeaderData& edited,
                      const std::set<std::string>& chosen, const FixContext& context)
{
    FileRepairs result;
    const auto composed = ComposeHeader(edited);
    const auto findings = CheckRecordForTracker(edited, composed, context.header.categories, context.colours);
    if (const auto stop = std::find_if(findings.begin(), findings.end(), stopsTheRules); stop != findings.end()) {
        result.left = stop->id + ": " + stop->text;
        return result;
    }
    const FindingPlaces places(bytes, edited, composed);

    // The header: the edits asked for, then each repair of the record, one step after the other.
    std::vector<std::pair<std::string, std::set<std::string>>> steps; // who changed which keys
    std::vector<FixNote> notes;
    auto previous = keyedLines(composed);
    steps.emplace_back("", keysChanged(keyedLines(ComposeHeader(read)), previous));
    notes.emplace_back();
    std::set<std::string> headerChosen, found;
    for (const auto& finding : findings)
        found.insert(finding.id);
    for (const auto& fix : TrackerFixes())
        if (fix.repairLine == nullptr && chosen.contains(fix.id))
            headerChosen.insert(fix.id);
    auto repaired = edited;
    FixForTracker(repaired, headerChosen, context, found, [&](const FixDone& done, const HeaderData& header) {
        auto now = keyedLines(ComposeHeader(header));
        steps.emplace_back(done.id, keysChanged(previous, now));
        notes.push_back(done.note);
        previous = std::move(now);
    });

    const HeaderEditor editor(places, read);
    const auto before = keyedLines(ComposeHeader(read));
    std::vector<std::pair<TextEdit, std::size_t>> edits; // with their order among insertions at one place
    std::map<std::string, std::vector<std::size_t>> keyLines;
    static const std::vector<std::string> none;
    for (const auto& key : keysChanged(before, previous)) {
        const auto& was = before.contains(key) ? before.at(key) : none;
        const auto& is = previous.contains(key) ? previous.at(key) : none;
        if (!editor.change(key, was, is, edits, keyLines[key])) {
            result.left = "the change of the " + shownKey(key) + " lines needs --recompose";
            return result;
        }
    }
    for (std::size_t k = 0; k < steps.size(); ++k) {
        const auto& [id, keys] = steps[k];
        FileRepair repair{id, {}, notes[k].fixed, notes[k].numbers, notes[k].left};
        for (const auto& key : keys)
            if (keyLines.contains(key))
                repair.lines.insert(repair.lines.end(), keyLines[key].begin(), keyLines[key].end());
        std::sort(repair.lines.begin(), repair.lines.end());
        if (!repair.lines.empty() || !repair.left.empty())
            result.repairs.push_back(std::move(repair));
    }
    repairBodyLines(places, findings, chosen, edits, result);
    // Insertions at one place go in the Tracker's order.
    std::stable_sort(edits.begin(), edits.end(), [](const auto& a, const auto& b) {
        return std::tie(a.first.begin, a.second) < std::tie(b.first.begin, b.second);
    });
    for (auto& [edit, order] : edits)
        result.edits.push_back(std::move(edit));
    return result;
}
