// SPDX-License-Identifier: MIT
#include "FixCommand.h"

#include <algorithm>
#include <optional>
#include <set>

#include "Batch.h"
#include "CliFiles.h"
#include "Clock.h"
#include "ClosestWord.h"
#include "ColourSource.h"
#include "ConsoleDialogs.h"
#include "FileRepairs.h"
#include "ListFolder.h"
#include "QmError.h"
#include "TrackerFixes.h"

namespace {

// The repairs chosen, or none when only names one that does not exist.
std::optional<std::set<std::string>> chosenFixes(const std::vector<std::string>& only, std::ostream& err)
{
    if (only.empty())
        return DefaultFixIds();
    std::set<std::string> chosen;
    for (const auto& id : only) {
        const auto& fixes = TrackerFixes();
        if (std::none_of(fixes.begin(), fixes.end(), [&id](const TrackerFix& fix) { return id == fix.id; })) {
            std::vector<std::string> ids;
            for (const auto& fix : fixes)
                ids.emplace_back(fix.id);
            err << "quillmark-cli: --only " << ShownText(id) << " is no repair's id";
            if (const auto closest = ClosestWord(id, ids); !closest.empty())
                err << "; did you mean " << closest << "?";
            err << " The repairs are:";
            for (const auto& known : ids)
                err << (&known == &ids.front() ? " " : ", ") << known;
            err << '\n';
            return std::nullopt;
        }
        chosen.insert(id);
    }
    return chosen;
}

std::vector<std::string> notesOf(const std::vector<FixDone>& done)
{
    std::vector<std::string> notes;
    for (const auto& [id, note] : done) {
        if (note.fixed > 0)
            notes.push_back("fixed " + id + " (" + std::to_string(note.fixed) + ")");
        for (const auto& why : note.left)
            notes.push_back("left " + id + ": " + why);
    }
    return notes;
}

// "line 5", "lines 5, 9", "lines 40–88".
std::string linesText(const std::vector<std::size_t>& lines)
{
    if (lines.size() == 1)
        return "line " + std::to_string(lines.front());
    if (lines.size() == 2)
        return "lines " + std::to_string(lines.front()) + ", " + std::to_string(lines.back());
    return "lines " + std::to_string(lines.front()) + "\u2013" + std::to_string(lines.back());
}

// The log of a file's repairs: each one that changed a line, with where, and each finding left.
std::vector<std::string> repairNotes(const std::vector<FileRepair>& repairs)
{
    std::vector<std::string> notes;
    for (const auto& repair : repairs) {
        if (!repair.lines.empty()) {
            const auto where = linesText(repair.lines);
            if (repair.id.empty())
                notes.push_back("edited the header (" + where + ")");
            else if (repair.numbers > 0)
                notes.push_back("fixed " + repair.id + " (" + std::to_string(repair.numbers) +
                                (repair.id == "line.invalidcoloredlines" ? " colour" : " number") +
                                (repair.numbers == 1 ? "" : "s") + ", " + where + ")");
            else
                notes.push_back("fixed " + repair.id + " (" + where + ")");
        }
        for (const auto& why : repair.left)
            notes.push_back("left " + repair.id + ": " + why);
    }
    return notes;
}

} // namespace

int RunFix(const std::vector<std::string>& arguments, const FixOptions& fix, const SaveOptions& options,
           EditOptions edit, const BatchOptions& batch, std::ostream& out, std::ostream& err)
{
    const auto chosen = chosenFixes(fix.only, err);
    if (!chosen)
        return ExitStatus::Usage;
    StringList categories;
    if (!ReadStandardList(ListKind::Category, categories, err))
        return ExitStatus::Unreadable;
    // The repairs do not depend on the colour codes: the checks around them only need the same ones.
    const auto coloursPath = DataFileOfThisProgram(ProgramFolder(), BuiltInColoursFile);
    std::optional<ColourCodes> colours;
    try {
        colours = ReadBuiltInColours(coloursPath);
    } catch (const QmError& failure) {
        err << "quillmark-cli: cannot read the colour list " << coloursPath << ": " << failure.description() << '\n';
        return ExitStatus::Unreadable;
    }
    const FixContext context{{categories, batch.limitDescription, SystemClock().now()}, *colours};
    if (fix.recompose) {
        edit.afterEdits = [&](HeaderData& header) { return notesOf(FixForTracker(header, *chosen, context)); };
        return RunEdit(arguments, options, std::move(edit), batch, out, err);
    }
    return RunRepair(
        arguments, options, edit, batch, out, err,
        [&](std::string_view bytes, const HeaderData& read, const HeaderData& edited) {
            auto repaired = RepairsOf(bytes, read, edited, *chosen, context);
            return FileEdits{std::move(repaired.edits), repairNotes(repaired.repairs), std::move(repaired.left)};
        });
}
