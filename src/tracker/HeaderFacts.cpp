#include "HeaderFacts.h"

#include <QRegularExpression>

namespace {

// The value after a meta line's keyword ("0 !LICENSE value"), or a null string for another line.
QString valueAfter(const QString& line, const QString& keyword)
{
    const auto start = QStringLiteral("0 ") + keyword;
    if (!line.startsWith(start) || (line.size() > start.size() && line.at(start.size()) != ' '))
        return {};
    return line.mid(start.size()).trimmed();
}

void takeTypeLine(HeaderFacts& facts, const QString& value)
{
    const auto words = value.split(' ', Qt::SkipEmptyParts);
    if (words.isEmpty())
        return;
    facts.hasType = true;
    facts.type = words.at(0);
    if (words.size() > 1 && QStringList{"Alias", "Flexible_Section", "Physical_Colour"}.contains(words.at(1)))
        facts.qualifier = words.at(1);
}

bool isGeometryLine(const QString& line)
{
    static const QRegularExpression geometry(QStringLiteral("^\\s*[1-5]\\s"));
    return geometry.match(line).hasMatch();
}

void takeHeaderLine(HeaderFacts& facts, const QString& line, QString& firstCategory)
{
    if (auto v = valueAfter(line, "Name:"); !v.isNull()) {
        if (facts.name.isEmpty()) {
            facts.hasName = !v.isEmpty();
            facts.name = v;
        }
    } else if (v = valueAfter(line, "Author:"); !v.isNull()) {
        facts.hasAuthor = true;
        facts.author = v;
    } else if (v = valueAfter(line, "!LDRAW_ORG"); !v.isNull()) {
        takeTypeLine(facts, v);
    } else if (v = valueAfter(line, "!LICENSE"); !v.isNull()) {
        facts.hasLicense = true;
        facts.license = v.simplified(); // runs of blanks collapsed
    } else if (v = valueAfter(line, "!CATEGORY"); !v.isNull()) {
        if (firstCategory.isNull())
            firstCategory = v;
    } else if (v = valueAfter(line, "!KEYWORDS"); !v.isNull()) {
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

HeaderFacts ReadHeaderFacts(const QString& text)
{
    HeaderFacts facts;
    const auto lines = text.split(QStringLiteral("\r\n"));
    if (!lines.isEmpty() && lines.at(0).startsWith("0 "))
        facts.description = lines.at(0).mid(2).trimmed();
    static const QRegularExpression prefix(QStringLiteral("^[~_=|]+"));
    facts.prefix = prefix.match(facts.description).captured(0);
    QString firstCategory;
    bool inHeader = true;
    for (qsizetype i = 1; i < lines.size(); ++i) {
        const auto& line = lines.at(i);
        inHeader = inHeader && !isGeometryLine(line);
        if (inHeader)
            takeHeaderLine(facts, line, firstCategory);
        if (line.trimmed().startsWith("1 "))
            facts.subfileLines << line.trimmed();
    }
    static const QRegularExpression blanks(QStringLiteral("\\s+"));
    facts.category = !firstCategory.isNull()
                         ? firstCategory
                         : facts.description.mid(facts.prefix.size()).section(blanks, 0, 0, QString::SectionSkipEmpty);
    return facts;
}
