// SPDX-License-Identifier: MIT
#include "Paths.h"

#include <filesystem>

#include "ErrorReport.h"
#include "SplitText.h"
#include "Text.h"

std::string DateiNurName(const std::string& path, Dialogs& dialogs)
{
    const auto pieces = SplitText(TrimBlanks(path), "/");
    if (pieces.empty()) {
        ReportError(dialogs, QmError(ErrorNumber::SubscriptOutOfRange, "Subscript out of range"),
                    {"DateiNurName", OwnerKind::Modul, "modFunctions"});
        return {};
    }
    return pieces.back();
}

std::string DateiNurPfad(const std::string& path)
{
    const auto pieces = SplitText(TrimBlanks(path), "/");
    std::string folder;
    for (std::size_t i = 0; i + 1 < pieces.size(); ++i) {
        if (i > 0)
            folder += '/';
        folder += pieces[i];
    }
    if (folder.empty() && pieces.size() > 1)
        return "/";
    return folder;
}

std::string AbsolutePath(const std::string& path)
{
    if (path.empty())
        return path;
    std::string absolute;
    for (const auto& piece : std::filesystem::absolute(path)) {
        const auto text = piece.string();
        if (text == "." || text.empty())
            continue;
        if (!absolute.empty() && absolute.back() != '/')
            absolute += '/';
        absolute += text;
    }
    return absolute;
}
