// SPDX-License-Identifier: MIT
#include "SaveStops.h"

#include <QCoreApplication>
#include <algorithm>
#include <string_view>

#include "FindingPlaces.h"
#include "PartFile.h"
#include "SaveChecks.h"
#include "TrackerFixes.h"

namespace {

std::string translated(const char* text) { return QCoreApplication::translate("SaveStops", text).toStdString(); }

std::string firstLine(const std::string& text) { return text.substr(0, text.find('\r')); }

// The field or preference that lifts a save check.
std::string liftOf(std::string_view id, const StopContext& context)
{
    if (id == SaveCheckIds::DescriptionLength)
        return translated("Lifted by a description of 64 characters or fewer, or by clearing ") + context.limitSwitch +
               ".";
    if (id == SaveCheckIds::Author)
        return translated("Lifted by a name in the Real Name field.");
    if (id == SaveCheckIds::UserName)
        return translated("Save asks whether to save without one; the Username field lifts it.");
    if (id == SaveCheckIds::Bfc)
        return translated("Lifted by a choice in the BFC Statement field.");
    if (id == SaveCheckIds::License)
        return translated("Lifted by a choice in the License Type field.");
    if (id == SaveCheckIds::PartType)
        return translated("Lifted by a choice in the Part Type field.");
    return translated("Lifted by a line in the Comments list.");
}

void addSaveCheckRows(std::vector<StopRow>& rows, const HeaderData& header, const StopContext& context)
{
    const auto save = EvaluateSaveChecks(header, context.limitDescription);
    for (std::size_t k = 0; k < save.refusals.size(); ++k)
        rows.push_back({{save.refusalIds[k], FindingLevel::Error, firstLine(save.refusals[k])},
                        false,
                        liftOf(save.refusalIds[k], context)});
    if (save.missingUserName)
        rows.push_back({{SaveCheckIds::UserName, FindingLevel::Warning, translated("The author line names no user.")},
                        false,
                        liftOf(SaveCheckIds::UserName, context)});
}

bool hasRepair(const std::string& id)
{
    const auto& fixes = TrackerFixes();
    return std::any_of(fixes.begin(), fixes.end(), [&id](const TrackerFix& fix) { return id == fix.id; });
}

// Tries the repair of id on a copy of the document: whether it changes anything, and if not, why.
void judgeRepair(StopRow& row, const HeaderData& header, const StopContext& context)
{
    auto trial = header;
    const FixContext fixing{{context.categories, context.limitDescription, context.today}, context.colours};
    std::string why;
    for (const auto& done : FixForTracker(trial, {row.finding.id}, fixing)) {
        if (done.note.fixed > 0) {
            row.repairable = true;
            return;
        }
        for (const auto& left : done.note.left)
            why += (why.empty() ? "" : "; ") + left;
    }
    row.note = translated("No repair here: ") + (why.empty() ? translated("it would change nothing") : why) + ".";
}

// Each row's line on disk, counted as the command line counts it; 0 for the file as a whole. The
// file is read again for them only when there are rows.
void placeRows(std::vector<StopRow>& rows, const HeaderData& header, const std::string& composedHeader)
{
    if (rows.empty() || !header.Part)
        return;
    const auto bytes = FileBytes(*header.Part).takeBytes();
    const FindingPlaces places(bytes, header, composedHeader);
    for (auto& row : rows) {
        const auto place = IsSaveCheckRow(row) ? places.ofHeaderKeyword(HeaderKeywordOfSaveCheck(row.finding.id))
                                               : places.of(row.finding);
        row.finding.line = place.wholeFile ? 0 : static_cast<int>(place.line);
    }
}

} // namespace

std::vector<StopRow> WhatStopsTheSave(const HeaderData& header, const std::string& composedHeader,
                                      const StopContext& context)
{
    std::vector<StopRow> rows;
    addSaveCheckRows(rows, header, context);
    for (auto& finding : CheckRecordForTracker(header, composedHeader, context.categories, context.colours)) {
        StopRow row{std::move(finding), false, {}};
        if (hasRepair(row.finding.id)) { // one trial per id: the rows of an id share its outcome
            const auto same = std::find_if(rows.begin(), rows.end(),
                                           [&row](const StopRow& other) { return other.finding.id == row.finding.id; });
            if (same != rows.end()) {
                row.repairable = same->repairable;
                row.note = same->note;
            } else
                judgeRepair(row, header, context);
        }
        rows.push_back(std::move(row));
    }
    placeRows(rows, header, composedHeader);
    return rows;
}

bool IsSaveCheckRow(const StopRow& row) { return row.finding.id.starts_with("save."); }
