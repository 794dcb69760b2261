// SPDX-License-Identifier: MIT
#include "ErrorReport.h"

#include "Dialogs.h"

namespace {

const char* ownerWord(OwnerKind kind)
{
    switch (kind) {
    case OwnerKind::Formular: return " of Formular ";
    case OwnerKind::Modul: return " of Modul ";
    case OwnerKind::Module: return " of Module ";
    }
    return " of Modul ";
}

} // namespace

std::string ErrorReportText(const QmError& error, const Procedure& procedure)
{
    auto text = "Error " + std::to_string(error.number()) + " (" + error.description() + ") in procedure " +
                procedure.name + ownerWord(procedure.kind) + procedure.owner;
    if (!error.detail().empty()) // what an author can act on: which file, and why
        text += "\r\n" + error.detail();
    return text;
}

void ReportError(Dialogs& dialogs, const QmError& error, const Procedure& procedure)
{
    dialogs.message(StopBox(ErrorReportText(error, procedure)));
}
