// SPDX-License-Identifier: MIT
#include "LanguageServerCommand.h"

#include <algorithm>
#include <unistd.h>

#include "CheckConfig.h"
#include "CliFiles.h"
#include "Clock.h"
#include "ColourSource.h"
#include "Dates.h"
#include "EditCommandLine.h"
#include "ListFolder.h"
#include "PartSettings.h"
#include "ServerLoop.h"
#include "TextCheck.h"

namespace {

std::string historyStart()
{
    const auto today = SystemClock().now();
    const auto user = HistoryUser("");
    return FormatDate(today.year, today.month, today.day) + " " + (user.empty() ? "" : "[" + user + "] ");
}

} // namespace

int RunLanguageServer(const LanguageServerOptions& options, std::ostream& err)
{
    StringList categories;
    ServerSetup setup;
    auto& lists = setup.lists;
    auto colours = ColourSourceFor(options.ldconfig, err);
    if (!colours || !ReadStandardList(ListKind::Category, categories, err) ||
        !ReadStandardList(ListKind::PartType, lists.partTypes, err) ||
        !ReadStandardList(ListKind::License, lists.licences, err) ||
        !ReadStandardList(ListKind::Bfc, lists.bfcStatements, err))
        return ExitStatus::Unreadable;
    lists.categories = CategoriesInForce(categories);
    const TrackerLists tracker{&categories, colours.get()};
    CommandLineSettings given;
    given.ldconfig = options.ldconfig;
    given.noLengthLimit = !options.limitDescription;
    setup.check = [&](const std::string& bytes, const std::string& path) {
        // As check: the quillmark.toml nearest the document's folder. Read for each check, so that
        // an edit of it counts from the next change on; a wrong one is told and not used.
        CheckConfigs configs({}, true);
        const auto config = configs.forPart(path);
        if (config.error != nullptr)
            err << "quillmark-cli: " << *config.error << '\n';
        return CheckPartText(bytes, path, SettingsForPart(given, config.config, path), tracker);
    };
    // The repairs do not depend on the colour codes, as for fix: the built-in list serves the checks around them.
    const auto builtIn = ReadBuiltInColours(DataFileOfThisProgram(ProgramFolder(), BuiltInColoursFile));
    setup.repair = [&](const std::string& bytes, const std::string& path, const std::set<std::string>& chosen) {
        const FixContext context{{categories, options.limitDescription, SystemClock().now()}, builtIn};
        return RepairPartText(bytes, path, chosen, context);
    };
    setup.historyStart = historyStart;
    setup.version = QUILLMARK_VERSION;
    return ServeLanguageClient(STDIN_FILENO, STDOUT_FILENO, setup);
}
