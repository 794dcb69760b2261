// SPDX-License-Identifier: MIT
#include "LanguageServerCommand.h"

#include <algorithm>
#include <unistd.h>

#include "CliFiles.h"
#include "Clock.h"
#include "ColourSource.h"
#include "Dates.h"
#include "EditCommandLine.h"
#include "ListFolder.h"
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
    const CheckSetup checks{options.limitDescription, &categories, colours.get()};
    setup.check = [&checks](const std::string& bytes, const std::string& path) {
        return CheckPartText(bytes, path, checks);
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
