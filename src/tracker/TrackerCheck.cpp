// SPDX-License-Identifier: MIT
#include "TrackerCheck.h"

#include <QRegularExpression>

#include "Findings.h"
#include "HeaderEdits.h"
#include "HeaderFacts.h"
#include "LineChecks.h"
#include "MetaLine.h"
#include "Text.h"

namespace {

const QStringList ApprovedLicences = {"Licensed under CC BY 4.0 : see CAreadme.txt",
                                      "Licensed under CC BY 2.0 and CC BY 4.0 : see CAreadme.txt",
                                      "Marked with CC0 1.0 : see CAreadme.txt"};
const QStringList PreviewRotations = {
    "1 0 0 0 1 0 0 0 1",  "1 0 0 0 0 1 0 -1 0",  "1 0 0 0 0 -1 0 1 0", "1 0 0 0 -1 0 0 0 -1", "0 0 1 0 1 0 -1 0 0",
    "0 0 -1 0 1 0 1 0 0", "-1 0 0 0 1 0 0 0 -1", "0 -1 0 1 0 0 0 0 1", "0 1 0 -1 0 0 0 0 1",  "-1 0 0 0 -1 0 0 0 1"};

struct Part {
    HeaderFacts facts;
    QString fileName;                       // the file's own name
    QString baseName;                       // lower case, without ".dat"
    QString plainType;                      // the type without "Unofficial_"
    bool partsType = false;                 // Part or Shortcut
    bool pattern = false;                   // a parts-type file whose name ends in a pattern's suffix
    const StringList* categories = nullptr; // the official ones, as the list file holds them

    bool inCategory(std::initializer_list<const char*> names) const
    {
        for (const char* name : names)
            if (facts.category.compare(QLatin1String(name), Qt::CaseInsensitive) == 0)
                return true;
        return false;
    }
};

QString quoted(const QString& text) { return "\"" + text + "\""; }

// Characters of the Unicode classes Other (controls, format characters such as U+200B, unassigned
// and private-use ones) and the line and paragraph separators.
bool hasForbiddenCharacters(const QString& text)
{
    for (const char32_t c : text.toUcs4()) {
        switch (QChar::category(c)) {
        case QChar::Other_Control:
        case QChar::Other_Format:
        case QChar::Other_Surrogate:
        case QChar::Other_PrivateUse:
        case QChar::Other_NotAssigned:
        case QChar::Separator_Line:
        case QChar::Separator_Paragraph: return true;
        default: break;
        }
    }
    return false;
}

// "Real Name [username]"; either part alone is accepted.
bool authorWellFormed(const QString& author)
{
    static const QRegularExpression form(QStringLiteral("^(?:[^\\[\\]]*[^\\[\\]\\s])?\\s*(?:\\[[A-Za-z0-9_.-]+\\])?$"));
    return form.match(author).hasMatch();
}

// The presence rule: when it fails, no other rule runs.
bool checkPresence(const Part& part, Findings& findings)
{
    const auto& f = part.facts;
    const std::pair<bool, const char*> needs[] = {
        {!f.description.isEmpty(), "The description (line 1) is missing."},
        {f.hasName, "The \"0 Name:\" line is missing or empty."},
        {f.hasType && KnownPartTypes.contains(part.plainType),
         "The \"0 !LDRAW_ORG\" line is missing or names no known type."},
        {f.hasLicense, "The \"0 !LICENSE\" line is missing."},
        {f.hasAuthor && !f.author.isEmpty(), "The \"0 Author:\" line is missing or empty."},
    };
    bool complete = true;
    for (const auto& [present, text] : needs)
        if (!present) {
            findings.error("missing", text);
            complete = false;
        }
    if (f.hasAuthor && !f.author.isEmpty() && !authorWellFormed(f.author)) {
        findings.error("authorinvalid", "The author " + quoted(f.author) +
                                            " is not of the form \"Real Name [username]\" (user name of letters, "
                                            "digits, \"_\", \".\" and \"-\").");
        complete = false;
    }
    return complete;
}

// The list file's entries are UTF-8, or Latin-1 when they are not valid UTF-8.
bool isOfficial(const QString& category, const StringList& categories)
{
    const auto utf8 = category.toStdString();
    for (const auto& entry : categories)
        if (entry != "<none>" && (IsValidUtf8(entry) ? entry == utf8 : QString::fromLatin1(entry) == category))
            return true;
    return false;
}

QString replacementOf(const QString& retiredCategory)
{
    if (retiredCategory == "Minifig")
        return "use a suitable active Minifig category";
    if (retiredCategory == "Forklift")
        return "use Vehicle";
    return "no replacement";
}

void checkLicenceAndCategory(const Part& part, Findings& findings)
{
    const auto& f = part.facts;
    if (!ApprovedLicences.contains(f.license))
        findings.error("license.approved", "The licence " + quoted(f.license) + " is not one the library accepts.");
    if (f.qualifier == "Physical_Colour" && !part.inCategory({"Obsolete"}))
        findings.error("type.phycolor",
                       "Physical_Colour is only allowed in category Obsolete, not " + quoted(f.category) + ".");
    if (part.partsType && !isOfficial(f.category, *part.categories) && !RetiredCategories.contains(f.category))
        findings.error("category.invalid", "The category " + quoted(f.category) + " is not an official one.");
    if (part.partsType && RetiredCategories.contains(f.category))
        findings.warning("warning.minifigcategory",
                         "The category " + quoted(f.category) + " is retired: " + replacementOf(f.category) + ".");
}

void checkHistory(const Part& part, Findings& findings)
{
    for (const auto& line : part.facts.historyLines)
        if (!IsHistoryLine(line))
            findings.error("history.invalid",
                           "The history line " + quoted(line) + " is not \"0 !HISTORY YYYY-MM-DD [user] comment\".");
}

void checkName(const Part& part, Findings& findings)
{
    const auto& f = part.facts;
    if (hasForbiddenCharacters(f.name))
        findings.error("name.invalidchars", "The name " + quoted(f.name) + " holds characters that are not allowed.");
    const auto baseName = f.name.mid(std::max(f.name.lastIndexOf('\\'), f.name.lastIndexOf('/')) + 1);
    if (baseName.startsWith('x', Qt::CaseInsensitive))
        findings.error("name.xparts", "The name " + quoted(f.name) + " starts with \"x\".");
    const auto folder = f.name.left(f.name.lastIndexOf('\\') + 1);
    const auto wanted = QString::fromStdString(NameFolderOfType(part.plainType.toStdString()));
    if (folder.compare(wanted, Qt::CaseInsensitive) != 0)
        findings.error("type.path", "A " + part.plainType + " is named " + quoted(wanted + "name.dat") + ", not " +
                                        quoted(f.name) + ".");
    const auto ownName = f.name.mid(folder.size());
    if (ownName.compare(part.fileName, Qt::CaseInsensitive) != 0)
        findings.warning("name.filename",
                         "The name " + quoted(ownName) + " is not the file's name " + quoted(part.fileName) + ".");
}

void checkDescriptionPrefix(const Part& part, Findings& findings)
{
    const auto& f = part.facts;
    const auto& prefix = f.prefix;
    if (part.plainType == "Subpart" && !prefix.startsWith('~'))
        findings.error("description.subpartdesc",
                       "A subpart's description must start with \"~\": " + quoted(f.description));
    else if (part.partsType && part.inCategory({"Moved", "Obsolete"}) && !prefix.startsWith('~'))
        findings.error("description.movedorobsolete",
                       "A moved or obsolete part's description must start with \"~\": " + quoted(f.description));
    else if (f.qualifier == "Alias" && !prefix.contains('='))
        findings.error("description.aliasdesc",
                       "An alias's description must start with \"=\": " + quoted(f.description));
    // The name's base is taken after its last "/" only: "s\\t12.dat" stays whole.
    else if (part.partsType && f.name.mid(f.name.lastIndexOf('/') + 1).startsWith('t', Qt::CaseInsensitive) &&
             !prefix.contains('|'))
        findings.error("description.thirdpartydesc",
                       "A third-party part's description must start with \"|\": " + quoted(f.description));
}

void checkDescription(const Part& part, Findings& findings)
{
    const auto& f = part.facts;
    if (hasForbiddenCharacters(f.description))
        findings.error("description.invalidchars",
                       "The description " + quoted(f.description) + " holds characters that are not allowed.");
    checkDescriptionPrefix(part, findings);
    if (const auto numbers = SingleBlankNumbers(f.description); !numbers.empty())
        findings.warning("warning.descriptionnumbers",
                         "The number " + f.description.mid(numbers[0].start, numbers[0].length).trimmed() + " in " +
                             quoted(f.description) +
                             " has one blank before it; the library writes two (\"Brick  1 x  2\").");
}

void checkPattern(const Part& part, Findings& findings)
{
    const auto& f = part.facts;
    if (!part.pattern)
        return;
    static const QRegularExpression patternWord(QStringLiteral("pattern(?:\\s*\\([^)]*\\))?$"),
                                                QRegularExpression::CaseInsensitiveOption);
    if (!part.inCategory({"Moved", "Sticker", "Sticker Shortcut"}) && !f.keywords.contains("Colour Combination") &&
        !patternWord.match(f.description).hasMatch())
        findings.error("description.patternword",
                       "A pattern's description must end in \"Pattern\": " + quoted(f.description));
    if (part.inCategory({"Modulex", "Moved"}))
        return;
    for (const auto& keyword : f.keywords)
        for (const char* start : {"set ", "cmf", "build-a-minifigure"})
            if (keyword.startsWith(QLatin1String(start), Qt::CaseInsensitive))
                return;
    findings.error("keywords.patternset",
                   "A pattern needs a keyword starting with \"Set \", \"CMF\" or \"Build-A-Minifigure\".");
}

void checkTypeQualifiers(const Part& part, Findings& findings)
{
    const auto& f = part.facts;
    if (f.qualifier == "Alias" && part.plainType != "Part" && part.plainType != "Shortcut")
        findings.error("type.alias", "Alias is only allowed on a Part or Shortcut, not a " + part.plainType + ".");
    if (f.qualifier != "Flexible_Section")
        return;
    if (part.plainType != "Part")
        findings.error("type.flex", "Flexible_Section is only allowed on a Part, not a " + part.plainType + ".");
    static const QRegularExpression flexName(QStringLiteral("k[0-9a-z]{2}$"));
    if (isOfficial(f.category, *part.categories) && !part.inCategory({"Moved", "Obsolete"}) &&
        !flexName.match(part.baseName).hasMatch())
        findings.error("name.flex",
                       "A flexible section's name must end in \"k\" and two characters: " + quoted(part.fileName));
}

void checkBody(const Part& part, Findings& findings)
{
    const auto& f = part.facts;
    if (f.firstBfcLine != "0 BFC CERTIFY CCW")
        findings.error("bfc", "The first BFC line is " + quoted(f.firstBfcLine) + ", not \"0 BFC CERTIFY CCW\".");
    const bool markedObsolete = f.description.contains("(Obsolete)") || f.description.startsWith("~Obsolete");
    if (part.partsType && part.inCategory({"Obsolete"}) != markedObsolete)
        findings.error("obsoleteimproper", markedObsolete ? "The description " + quoted(f.description) +
                                                                " marks the part obsolete, but its category is " +
                                                                quoted(f.category) + ", not Obsolete."
                                                          : "The category is Obsolete, but the description " +
                                                                quoted(f.description) + " does not say so.");
    for (const auto& line : f.previewLines) {
        const auto words = line.split(' ', Qt::SkipEmptyParts);
        if (words.size() != 15 || !PreviewRotations.contains(words.mid(6).join(' ')))
            findings.warning("warning.previewinvalid", "The preview line " + quoted(line) + " is not allowed.");
    }
}

// The strict reading of a name's suffix, token by token, each at the first form that fits; the
// kinds of the tokens read, or none when a part of the suffix fits no form.
std::optional<QString> suffixTokens(const QString& suffix)
{
    static const QRegularExpression token(
        QStringLiteral("\\G(?:(p)\\d{4}|(p)[cd][0-9a-z][0-9a-l]|(p)[0-9a-z]{2}|([cdk])[0-9a-z]{2}|(-)f[0-9a-z])"));
    QString kinds;
    for (qsizetype at = 0; at < suffix.size();) {
        const auto match = token.match(suffix, at);
        if (!match.hasMatch())
            return std::nullopt;
        for (int group = 1; group <= match.lastCapturedIndex(); ++group)
            kinds += match.captured(group);
        at = match.capturedEnd();
    }
    return kinds;
}

// A pattern's name ends in a suffix of pattern tokens ("p" and two to four characters), maybe
// with colour or flex tokens ("c01", "d01", "k01") and a trailing "-f" token. The suffix is the
// leftmost tail made of such tokens in their loose form; it must then read in the strict form,
// and its last token (before "-f") must be a pattern token. So "3626bpx1", "973p37", "4073pc01"
// ("pc01": p, a c/d, a character, a character up to "l") and "3001p1234" are patterns;
// "22385p026" ("p02" then a lone "6"), "3002p18b" and "3001p01c01" (ends in "c01") are not.
bool isPatternName(const QString& fileName)
{
    static const QRegularExpression looseSuffix(QStringLiteral("(?:p[a-z0-9]{2,4}|[cdk][0-9a-z]{2})+(?:-f[0-9a-z])?$"));
    auto base = fileName.toLower();
    base = base.mid(std::max(base.lastIndexOf('\\'), base.lastIndexOf('/')) + 1);
    if (base.endsWith(".dat"))
        base.chop(4);
    const auto suffix = looseSuffix.match(base);
    if (!suffix.hasMatch())
        return false;
    auto kinds = suffixTokens(suffix.captured(0));
    if (!kinds)
        return false;
    if (kinds->endsWith('-'))
        kinds->chop(1);
    return kinds->endsWith('p');
}

QString fromFile(std::string_view bytes)
{
    return IsValidUtf8(bytes) ? QString::fromUtf8(bytes.data(), static_cast<qsizetype>(bytes.size()))
                              : QString::fromLatin1(bytes.data(), static_cast<qsizetype>(bytes.size()));
}

} // namespace

const char* LevelText(FindingLevel level) { return level == FindingLevel::Error ? "error" : "warning"; }

std::vector<TrackerFinding> CheckForTracker(std::string_view text, const std::string& fileName,
                                            const StringList& categories, const ColourCodes& colours)
{
    const bool utf8 = IsValidUtf8(text);
    std::string converted;
    if (!utf8)
        converted = Latin1ToUtf8(text);
    const auto utf8Text = utf8 ? text : std::string_view(converted);
    Part part;
    part.facts = ReadHeaderFacts(utf8Text);
    part.fileName = fromFile(fileName);
    part.baseName = part.fileName.toLower().section('.', 0, 0);
    part.plainType = PlainType(part.facts.type);
    part.partsType = part.plainType == "Part" || part.plainType == "Shortcut";
    part.pattern = part.partsType && isPatternName(part.fileName);
    part.categories = &categories;
    Findings findings;
    if (checkPresence(part, findings)) {
        checkLicenceAndCategory(part, findings);
        checkHistory(part, findings);
        checkName(part, findings);
        checkDescription(part, findings);
        checkPattern(part, findings);
        checkTypeQualifiers(part, findings);
        checkBody(part, findings);
        const auto name = part.facts.name.toStdString();
        const LinePart linePart{colours, name,
                                part.partsType && part.facts.category == QLatin1String("Sticker Shortcut")};
        CheckLines(utf8Text, linePart, findings);
    }
    return findings.take();
}

std::vector<TrackerFinding> CheckRecordForTracker(const HeaderData& header, const std::string& composedHeader,
                                                  const StringList& categories, const ColourCodes& colours)
{
    const auto slash = header.FilePath.rfind('/');
    const auto fileName = slash == std::string::npos ? header.FilePath : header.FilePath.substr(slash + 1);
    std::string text; // built in one piece: the body may be megabytes
    text.reserve(composedHeader.size() + header.Body.size() + 2);
    text.append(composedHeader).append(header.Body).append("\r\n");
    return CheckForTracker(text, fileName, categories, colours);
}
