// SPDX-License-Identifier: MIT
#include "HeaderFixes.h"

#include <QString>

#include "HeaderEdits.h"
#include "HeaderFacts.h"
#include "SaveChecks.h"
#include "Text.h"

namespace {

QString shown(const HeaderData& header, const std::string& bytes)
{
    const auto size = static_cast<qsizetype>(bytes.size());
    return header.Encoding == TextEncoding::Utf8 ? QString::fromUtf8(bytes.data(), size)
                                                 : QString::fromLatin1(bytes.data(), size);
}

std::string written(const HeaderData& header, const QString& text)
{
    return header.Encoding == TextEncoding::Utf8 ? text.toStdString() : text.toLatin1().toStdString();
}

// A new description is only taken when the save would take it.
bool setDescription(HeaderData& header, const HeaderFixContext& context, const QString& description, FixNote& note,
                    const char* change)
{
    const auto bytes = written(header, description);
    if (context.limitDescription && CharacterCount(bytes, header.Encoding) > DescriptionLimit) {
        note.left.push_back(std::string(change) + " would make the description longer than " +
                            std::to_string(DescriptionLimit) + " characters");
        return false;
    }
    header.PartDescription = bytes;
    return true;
}

// The description's leading run of "~", "_", "=" and "|" does not belong to its words.
QString descriptionWords(const QString& description)
{
    qsizetype start = 0;
    while (start < description.size() && QStringLiteral("~_=|").contains(description.at(start)))
        ++start;
    return description.mid(start);
}

// The longest active category that the description begins with, as whole words.
QString categoryBeginning(const QString& words, const StringList& categories, const HeaderData& header)
{
    QString best;
    for (const auto& entry : categories) {
        const auto category = shown(header, entry);
        if (entry == "<none>" || RetiredCategories.contains(category) || category.size() <= best.size() ||
            !words.startsWith(category))
            continue;
        if (words.size() == category.size() || !words.at(category.size()).isLetterOrNumber())
            best = category;
    }
    return best;
}

} // namespace

void FixLicence(HeaderData& header, const HeaderFixContext& context, FixNote& note)
{
    HeaderEdits edits;
    edits.license = std::string(CurrentLicense);
    ApplyHeaderEdits(header, edits, context.today);
    ++note.fixed;
}

void FixNameFolder(HeaderData& header, const HeaderFixContext& context, FixNote& note)
{
    HeaderEdits edits;
    edits.nameFromPath = true;
    ApplyHeaderEdits(header, edits, context.today);
    ++note.fixed;
}

void FixDescriptionNumbers(HeaderData& header, const HeaderFixContext& context, FixNote& note)
{
    auto description = shown(header, header.PartDescription);
    const auto numbers = SingleBlankNumbers(description);
    for (auto number = numbers.rbegin(); number != numbers.rend(); ++number)
        description.insert(number->start, ' ');
    if (setDescription(header, context, description, note, "a second blank before each number"))
        note.fixed += static_cast<int>(numbers.size());
}

void FixPatternWord(HeaderData& header, const HeaderFixContext& context, FixNote& note)
{
    if (setDescription(header, context, shown(header, header.PartDescription) + " Pattern", note, "\" Pattern\""))
        ++note.fixed;
}

void FixRetiredCategory(HeaderData& header, const HeaderFixContext& context, FixNote& note)
{
    const auto description = descriptionWords(shown(header, header.PartDescription));
    const bool fromDescription = header.Category.empty() || header.Category == "<none>";
    const auto retired = fromDescription ? description.section(' ', 0, 0, QString::SectionSkipEmpty)
                                         : shown(header, header.Category).simplified();
    const auto active =
        retired == "Forklift" ? QStringLiteral("Vehicle") : categoryBeginning(description, context.categories, header);
    if (active.isEmpty()) {
        note.left.push_back("the category " + retired.toStdString() + " needs a category chosen by hand");
        return;
    }
    header.Category = written(header, active);
    ++note.fixed;
}
