// SPDX-License-Identifier: MIT
#pragma once

#include <QLocale>
#include <string>

// The language the window speaks: the user's locale, unless QUILLMARK_LANGUAGE names another
// ("en" forces English). The command-line tool always speaks English.
QLocale WindowLocale(const QLocale& system);

// Installs in the application the window's translation into the locale's language, found
// beside the program (translations/ of a build folder) or among the installed data, and Qt's
// own for its standard buttons. Returns whether the window's translation was found; English
// needs none.
bool InstallWindowTranslation(const QLocale& locale, const std::string& programFolder);
