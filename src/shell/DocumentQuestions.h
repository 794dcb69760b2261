// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <optional>
#include <string>

#include "AppState.h"
#include "ListKinds.h"

// The questions the window asks before it saves, discards or opens, and what follows from each
// answer. The window only shows the outcome.

// The close question when the file has changed: Yes saves without the checks, No discards,
// Cancel stays. True when the window may close.
bool MayCloseWindow(AppState& app, Services& services, const std::string& newHeader);

// Before another file replaces the open one (the Open command, a drop, the recent files): asked
// when the file has changed; Yes saves with the checks (saveWithChecks, which the window runs so
// that it can point at a refused description), No discards, Cancel stays. True when the open may
// go on.
bool MayOpenAnotherFile(const AppState& app, Dialogs& dialogs, const std::function<bool()>& saveWithChecks);

// The list editor for kind opens at once, the category list only after the user agrees to the
// warning that changing categories may break the library's rules.
bool MayEditList(ListKind kind, Dialogs& dialogs);

// "Set Preferences": the preferences are read again; while they hold no name the user is told so
// and nothing changes. Otherwise, on Yes to the question, the record takes each stored name that
// is not empty (toFile turns it into the file's encoding, or refuses), and the stored licence when
// the licence list holds it. False when nothing was taken.
using ToFileText = std::function<std::optional<std::string>(const std::string& utf8)>;
bool TakePreferencesIntoRecord(AppState& app, Services& services, const ToFileText& toFile);
