// SPDX-License-Identifier: MIT
#include "FixCommand.h"

#include <algorithm>
#include <optional>
#include <set>

#include "Batch.h"
#include "CliFiles.h"
#include "Clock.h"
#include "ColourSource.h"
#include "ConsoleDialogs.h"
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
            err << "quillmark-cli: --only " << ShownText(id) << " is not one of:";
            for (const auto& fix : fixes)
                err << (&fix == &fixes.front() ? " " : ", ") << fix.id;
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

} // namespace

int RunFix(const std::vector<std::string>& arguments, const std::vector<std::string>& only, const SaveOptions& options,
           EditOptions edit, const BatchOptions& batch, std::ostream& out, std::ostream& err)
{
    const auto chosen = chosenFixes(only, err);
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
    edit.afterEdits = [&](HeaderData& header) { return notesOf(FixForTracker(header, *chosen, context)); };
    return RunEdit(arguments, options, std::move(edit), batch, out, err);
}
