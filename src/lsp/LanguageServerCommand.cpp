// SPDX-License-Identifier: MIT
#include "LanguageServerCommand.h"

#include <algorithm>
#include <unistd.h>

#include "CliFiles.h"
#include "Clock.h"
#include "ColourSource.h"
#include "Dates.h"
#include "EditCommandLine.h"
#include "HeaderFacts.h"
#include "ServerLoop.h"
#include "TextCheck.h"

namespace {

// The categories an author may choose: the list's entries without the retired ones and the
// window's "<none>".
StringList categoriesInForce(StringList categories)
{
    std::erase_if(categories, [](const std::string& category) {
        return category.starts_with('<') || RetiredCategories.contains(QString::fromStdString(category));
    });
    return categories;
}

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
    lists.categories = categoriesInForce(categories);
    const CheckSetup checks{options.limitDescription, &categories, colours.get()};
    setup.check = [&checks](std::string bytes, const std::string& path) {
        return CheckPartText(std::move(bytes), path, checks);
    };
    setup.historyStart = historyStart;
    setup.version = QUILLMARK_VERSION;
    return ServeLanguageClient(STDIN_FILENO, STDOUT_FILENO, setup);
}
