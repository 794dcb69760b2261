// SPDX-License-Identifier: MIT
#include "EditCommandLine.h"

#include <algorithm>

#include "CliFiles.h"
#include "ConsoleDialogs.h"
#include "EditValues.h"
#include "IniSettingsStore.h"
#include "Preferences.h"

namespace {

void addText(CLI::App& command, const std::string& name, std::optional<std::string>& field, const std::string& help)
{
    command.add_option_function<std::string>(
        name, [&field](const std::string& value) { field = value; }, help);
}

void addKeywordList(CLI::App& command, const std::string& name, StringList& field, const std::string& help)
{
    command.add_option_function<std::string>(
        name, [&field](const std::string& value) { field = SplitKeywords(value); }, help);
}

// A value that must be an entry of its standard list: when it is not, says so naming the entries.
bool inList(const std::optional<std::string>& value, ListKind kind, const char* option, std::ostream& err,
            std::initializer_list<std::string_view> alsoAllowed = {})
{
    StringList entries;
    if (!value || std::find(alsoAllowed.begin(), alsoAllowed.end(), *value) != alsoAllowed.end())
        return true;
    if (!ReadStandardList(kind, entries, err))
        return false;
    if (std::find(entries.begin(), entries.end(), *value) != entries.end())
        return true;
    err << "quillmark-cli: " << option << " " << ShownText(*value) << " is not in the list:";
    for (const auto& entry : entries)
        err << (&entry == &entries.front() ? " " : ", ") << ShownText(entry);
    err << '\n';
    return false;
}

} // namespace

void AddEditOptions(CLI::App& command, EditOptions& edit, bool& noCategory)
{
    auto& e = edit.edits;
    addText(command, "--description", e.description, "The description");
    addText(command, "--author", e.author, "\"Real Name [user]\"; either part alone changes that part only");
    addText(command, "--type", e.type, "The part type, an entry of the part type list");
    addText(command, "--update", e.update, "The update tag, YYYY-RR (year and release)");
    addText(command, "--license", e.license,
            "The licence, an entry of the licence list; \"current\": a file under the CC BY 4.0 or the CC0 text "
            "keeps it; any other gets CC BY 4.0 when its first history line is dated 2023-03-05 or later, else "
            "CC BY 2.0 and CC BY 4.0");
    addText(command, "--bfc", e.bfc, "The BFC statement, an entry of the BFC list; CW and CCW are never swapped");
    auto* category = command.add_option_function<std::string>(
        "--category", [&e](const std::string& value) { e.category = value; }, "The category, an entry of its list");
    command.add_flag("--no-category", noCategory, "Remove the category line")->excludes(category);
    addKeywordList(command, "--add-keywords", e.addKeywords, "Keywords \"a, b\" added at the end, none twice");
    addKeywordList(command, "--remove-keywords", e.removeKeywords, "Keywords \"a, b\" removed, in any case");
    addText(command, "--add-history", e.addHistory, "Adds the history line \"YYYY-MM-DD [user] TEXT\" of today");
    command.add_option("--as", e.historyUser, "The user of --add-history (default: the preferences' user name)");
    command.add_flag("--name-from-path", e.nameFromPath,
                     "Name: becomes the file's name, after the folder its type wants (s\\, 8\\, 48\\, helpers\\)");
    command.add_flag("--dry-run", edit.dryRun,
                     "Write nothing; print on standard output only the unified diff of each file that would change, "
                     "which patch -p1 run in the current folder applies; messages go to standard error");
    command.add_flag("--json", edit.json,
                     "Write nothing; print per file one JSON object with its path, old and new header and what the "
                     "save checks say (the texts of a file that is valid UTF-8 as UTF-8, of any other as ISO-8859-1)");
}

std::string HistoryUser(const std::string& given)
{
    if (!given.empty())
        return given;
    Preferences preferences;
    LadeDefaults(preferences, IniSettingsStore());
    return preferences.DefaultUserName;
}

bool EditsValid(const HeaderEdits& edits, std::ostream& err)
{
    if (edits.addHistory && edits.historyUser.empty()) {
        err << "quillmark-cli: --add-history needs a user: --as USER, or a user name in the preferences\n";
        return false;
    }
    if (!EditValuesValid(edits, err))
        return false;
    const bool listed = inList(edits.type, ListKind::PartType, "--type", err) &&
                        inList(edits.license, ListKind::License, "--license", err, {CurrentLicense}) &&
                        inList(edits.bfc, ListKind::Bfc, "--bfc", err) &&
                        inList(edits.category, ListKind::Category, "--category", err, {""});
    return listed;
}
