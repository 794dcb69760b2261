// SPDX-License-Identifier: MIT
#pragma once

#include <string>

#include "QmError.h"

class Dialogs;

// Where a failing procedure lives, as the report names it: a window ("Formular"), a code
// module ("Modul"), and the one spelling that saving has always used ("Module").
enum class OwnerKind { Formular, Modul, Module };

struct Procedure {
    const char* name;
    OwnerKind kind;
    const char* owner;
};

// "Error N (description) in procedure P of Modul M": the one place that builds the text. The
// error's detail, when it has one, follows on a line of its own.
std::string ErrorReportText(const QmError& error, const Procedure& procedure);

// Shows the report in an OK-only box titled with the program's name.
void ReportError(Dialogs& dialogs, const QmError& error, const Procedure& procedure);
