// SPDX-License-Identifier: MIT
#include "TrackerFixes.h"

#include <algorithm>

#include "Composer.h"
#include "TrackerCheck.h"

namespace {

// The body's first line in the saved file comes after the composed header's lines.
int firstBodyLine(const HeaderData& header)
{
    const auto composed = ComposeHeader(header);
    return static_cast<int>(std::count(composed.begin(), composed.end(), '\n')) + 1;
}

template <NumberFix Fix>
void fixNumbers(HeaderData& header, const HeaderFixContext&, FixNote& note)
{
    note = FixNumbers(header.Body, Fix, firstBodyLine(header));
    header.BodyChanged = header.BodyChanged || note.fixed > 0;
}

void fixLineColours(HeaderData& header, const HeaderFixContext&, FixNote& note)
{
    note = FixLineColours(header.Body, firstBodyLine(header));
    header.BodyChanged = header.BodyChanged || note.fixed > 0;
}

template <NumberFix Fix>
std::optional<std::string> numbersOfLine(std::string_view line, std::size_t number, FixNote& note)
{
    return FixLineNumbers(line, Fix, number, note);
}

std::optional<std::string> colourOfLine(std::string_view line, std::size_t, FixNote& note)
{
    return FixLineColour(line, note);
}

std::set<std::string> idsFound(const HeaderData& header, const FixContext& context)
{
    std::set<std::string> ids;
    for (const auto& finding :
         CheckRecordForTracker(header, ComposeHeader(header), context.header.categories, context.colours))
        ids.insert(finding.id);
    return ids;
}

// The header's fields without the body, which no checked repair changes.
HeaderData headerFields(HeaderData& header)
{
    auto body = std::move(header.Body);
    HeaderData fields = header;
    header.Body = std::move(body);
    return fields;
}

void restoreHeaderFields(HeaderData& header, HeaderData fields)
{
    fields.Body = std::move(header.Body);
    header = std::move(fields);
}

} // namespace

const std::vector<TrackerFix>& TrackerFixes()
{
    static const std::vector<TrackerFix> fixes = {
        {"license.approved", true, false, FixLicence},
        {"type.path", true, true, FixNameFolder},
        {"warning.descriptionnumbers", true, true, FixDescriptionNumbers},
        {"description.patternword", true, true, FixPatternWord},
        {"warning.minifigcategory", true, true, FixRetiredCategory},
        {"numbers.trailingzeros", true, false, fixNumbers<NumberFix::TrailingZeros>,
         numbersOfLine<NumberFix::TrailingZeros>},
        {"numbers.leadingzeros", true, false, fixNumbers<NumberFix::LeadingZeros>,
         numbersOfLine<NumberFix::LeadingZeros>},
        {"numbers.decimalprecision", true, false, fixNumbers<NumberFix::DecimalPrecision>,
         numbersOfLine<NumberFix::DecimalPrecision>},
        // Changes how the part looks, so only when asked for by name.
        {"line.invalidcoloredlines", false, false, fixLineColours, colourOfLine},
    };
    return fixes;
}

std::set<std::string> DefaultFixIds()
{
    std::set<std::string> ids;
    for (const auto& fix : TrackerFixes())
        if (fix.onByDefault)
            ids.insert(fix.id);
    return ids;
}

std::vector<FixDone> FixForTracker(HeaderData& header, const std::set<std::string>& chosen, const FixContext& context)
{
    return FixForTracker(header, chosen, context, idsFound(header, context), {});
}

std::vector<FixDone> FixForTracker(HeaderData& header, const std::set<std::string>& chosen, const FixContext& context,
                                   const std::set<std::string>& before,
                                   const std::function<void(const FixDone&, const HeaderData&)>& step)
{
    std::vector<FixDone> done;
    for (const auto& fix : TrackerFixes()) {
        if (!chosen.contains(fix.id) || !before.contains(fix.id))
            continue;
        auto& [id, note] = done.emplace_back(FixDone{fix.id, {}});
        auto fields = fix.checkedAfter ? headerFields(header) : HeaderData{};
        fix.apply(header, context.header, note);
        if (fix.checkedAfter && note.fixed > 0) {
            const auto after = idsFound(header, context);
            const auto brought =
                std::find_if(after.begin(), after.end(), [&](const auto& a) { return !before.contains(a); });
            if (brought != after.end()) {
                restoreHeaderFields(header, std::move(fields));
                note = {0, 0, {"fixing it would bring " + *brought}};
            }
        }
        if (step)
            step(done.back(), header);
    }
    return done;
}
