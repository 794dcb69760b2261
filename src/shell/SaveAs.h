// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <optional>
#include <string>

#include "AppState.h"
#include "SaveChecks.h"

// Saving where the part read cannot be written, and saving under another name.

// Why this user cannot write the part read, in the system's words ("permission denied"); empty
// when it can be written, or when no file was read.
std::string WhyNotWritable(const HeaderData& header);

// Before a save: a part that cannot be written is named with the reason, and Save As offered.
enum class UnwritableAnswer { Writable, SaveAs, Stay };
UnwritableAnswer AskAboutUnwritablePart(const HeaderData& header, Dialogs& dialogs);

// The Save As file dialog, starting in the part's folder; nullopt when cancelled.
std::optional<std::string> ChooseNewName(const HeaderData& header, Dialogs& dialogs);

// Save As to path: an existing file there is replaced only after the user agreed; the "Name:" line
// is offered the new name when it says another (recompose shows the change). The document is then
// saved through save (the checks, fix-ups and writing of every save) as the file at path, with no
// backup of a file that did not exist; once saved, path is the document's file, stored as
// "LastPath" and in the recent files. Anything short of a save leaves the document as it was.
SaveOutcome SaveUnderNewName(AppState& app, Services& services, const std::string& path,
                             const std::function<SaveOutcome()>& save, const std::function<void()>& recompose);
