// SPDX-License-Identifier: MIT
#include "HeaderFacts.h"

#include <QRegularExpression>

#include "MetaLine.h"

namespace {

// The value after a meta line's keyword ("0 !LICENSE value"), or a null string for another line.
QString valueAfter(const QString& line, QLatin1StringView keyword)
{
    const auto end = 2 + keyword.size();
    if (!line.startsWith(u"0 ") || !QStringView(line).mid(2).startsWith(keyword) ||
        (line.size() > end && line.at(end) != ' '))
        return {};
    return line.mid(end).trimmed();
}

// A type line that does not read as a whole as a part type names none.
void takeTypeLine(HeaderFacts& facts, const QString& value)
{
    const auto type = value.simplified(); // runs of blanks collapsed
    if (!IsPartTypeLine("0 !LDRAW_ORG " + type))
        return;
    const auto words = type.split(' ');
    facts.hasType = true;
    facts.type = words.at(0);
    if (words.size() > 1 && QStringList{"Alias", "Flexible_Section", "Physical_Colour"}.contains(words.at(1)))
        facts.qualifier = words.at(1);
}

// Line 1 is the description unless it is one of the header's own meta lines.
bool isHeaderMeta(const QString& line)
{
    static const QStringList metas = {"!LDRAW_ORG", "!LICENSE", "!HELP",    "BFC",      "!CATEGORY",
                                      "!KEYWORDS",  "!CMDLINE", "!HISTORY", "!PREVIEW", "//"};
    const auto word = line.mid(2).section(' ', 0, 0, QString::SectionSkipEmpty);
    return word.startsWith(u"Name:") || word.startsWith(u"Author:") || metas.contains(word);
}

bool isSpace(char c) { return c == ' ' || (c >= '\t' && c <= '\r'); }

// A line of type 1 to 5 ends the header, even with blanks before it.
bool isGeometryLine(std::string_view line)
{
    std::size_t i = 0;
    while (i < line.size() && isSpace(line[i]))
        ++i;
    return i + 1 < line.size() && line[i] >= '1' && line[i] <= '5' && isSpace(line[i + 1]);
}

void takeHeaderLine(HeaderFacts& facts, const QString& line, QString& firstCategory)
{
    if (auto v = valueAfter(line, QLatin1StringView("Name:")); !v.isNull()) {
        if (facts.name.isEmpty()) {
            facts.hasName = !v.isEmpty();
            facts.name = v;
        }
    } else if (v = valueAfter(line, QLatin1StringView("Author:")); !v.isNull()) {
        facts.hasAuthor = true;
        facts.author = v;
    } else if (v = valueAfter(line, QLatin1StringView("!LDRAW_ORG")); !v.isNull()) {
        takeTypeLine(facts, v);
    } else if (v = valueAfter(line, QLatin1StringView("!LICENSE")); !v.isNull()) {
        facts.hasLicense = true;
        facts.license = v.simplified(); // runs of blanks collapsed
    } else if (v = valueAfter(line, QLatin1StringView("!CATEGORY")); !v.isNull()) {
        if (firstCategory.isNull())
            firstCategory = v.simplified(); // runs of blanks collapsed
    } else if (v = valueAfter(line, QLatin1StringView("!KEYWORDS")); !v.isNull()) {
        for (const auto& keyword : v.split(','))
            if (!keyword.trimmed().isEmpty())
                facts.keywords << keyword.trimmed();
    } else if (line.startsWith("0 !HISTORY")) {
        facts.historyLines << line;
    } else if (line.startsWith("0 !PREVIEW")) {
        facts.previewLines << line;
    } else if (line.startsWith("0 BFC") && facts.firstBfcLine.isNull()) {
        facts.firstBfcLine = line;
    }
}

} // namespace

QString PlainType(const QString& type)
{
    return type.startsWith("Unofficial_") ? type.mid(QStringLiteral("Unofficial_").size()) : type;
}

const QStringList RetiredCategories = {"Minifig", "Pov-RAY", "Lever", "Grab", "Forklift"};

std::vector<SingleBlankNumber> SingleBlankNumbers(const QString& description)
{
    static const QRegularExpression singleBlankNumber(
        QStringLiteral("(?<!\\s)\\s(?<!Type\\s)(?<!Phase\\s)(?<!Functions\\s)\\d(?:\\.\\d+)?\\b(?![\\d\"/-])"
                       "(?!\\s+(?:Ball|Balls|Stripe|Stripes|White)\\b)"),
        QRegularExpression::CaseInsensitiveOption | QRegularExpression::UseUnicodePropertiesOption);
    std::vector<SingleBlankNumber> numbers;
    for (auto it = singleBlankNumber.globalMatch(description); it.hasNext();) {
        const auto match = it.next();
        numbers.push_back({match.capturedStart(0), match.capturedLength(0)});
    }
    return numbers;
}

const QStringList KnownPartTypes = {"Part",         "Subpart",  "Primitive", "8_Primitive",
                                    "48_Primitive", "Shortcut", "Helper"};

HeaderFacts ReadHeaderFacts(std::string_view text)
{
    HeaderFacts facts;
    QString firstCategory;
    for (std::size_t start = 0, number = 0; start <= text.size(); ++number) {
        const auto end = std::min(text.find("\r\n", start), text.size());
        const auto bytes = text.substr(start, end - start);
        start = end + 2;
        if (isGeometryLine(bytes))
            break;
        const auto line = QString::fromUtf8(bytes.data(), static_cast<qsizetype>(bytes.size()));
        if (number == 0 && line.startsWith("0 ") && !isHeaderMeta(line))
            facts.description = line.mid(2).trimmed();
        else if (number > 0 || isHeaderMeta(line))
            takeHeaderLine(facts, line, firstCategory);
    }
    static const QRegularExpression prefix(QStringLiteral("^[~_=|]+"));
    facts.prefix = prefix.match(facts.description).captured(0);
    static const QRegularExpression blanks(QStringLiteral("\\s+"));
    facts.category = !firstCategory.isNull()
                         ? firstCategory
                         : facts.description.mid(facts.prefix.size()).section(blanks, 0, 0, QString::SectionSkipEmpty);
    return facts;
}
