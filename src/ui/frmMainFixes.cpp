// SPDX-License-Identifier: MIT
// The Parts Tracker's repairs, made on the open document from the Tracker dialog.
#include <QComboBox>
#include <QLineEdit>

#include "FileText.h"
#include "TrackerFixes.h"
#include "frmMain.h"

// The repairs change the record as an edit does; nothing is saved until the user saves.
std::vector<StopRow> frmMain::fixForTracker(const std::set<std::string>& ids, const StringList& categories,
                                            const ColourCodes& colours)
{
    const FixContext context{{categories, app_.Prefs.LimitDescription, services_.clock.now()}, colours};
    FixForTracker(app_.Header, ids, context);
    showFixedFields();
    return stopRows(categories, colours);
}

// The fields a repair may change, shown in their controls, and the header composed again.
void frmMain::showFixedFields()
{
    const auto encoding = app_.Header.Encoding;
    txPartDescription->setText(ToWidget(app_.Header.PartDescription, encoding));
    txFileName->setText(ToWidget(app_.Header.PartName, encoding));
    showTextsFromTheirStart();
    SelectComboItem(*cbLicenses, app_.Header.License);
    SelectComboItem(*cbCategory, app_.Header.Category);
    MakeNewHeader();
}
