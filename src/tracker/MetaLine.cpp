// SPDX-License-Identifier: MIT
#include "MetaLine.h"

#include <QRegularExpression>
#include <utility>

#include "GeometryLine.h"
#include "HeaderFacts.h"

namespace {

using Pattern = QRegularExpression;
constexpr auto Unicode = QRegularExpression::UseUnicodePropertiesOption;

const std::pair<std::string_view, MetaWord> Words[] = {
    {"!LDRAW_ORG", MetaWord::LDrawOrg},
    {"!LICENSE", MetaWord::License},
    {"!HELP", MetaWord::Help},
    {"!CATEGORY", MetaWord::Category},
    {"!KEYWORDS", MetaWord::Keywords},
    {"!CMDLINE", MetaWord::CmdLine},
    {"BFC", MetaWord::Bfc},
    {"!PREVIEW", MetaWord::Preview},
    {"!HISTORY", MetaWord::History},
    {"!TEXMAP", MetaWord::TexMap},
    {"//", MetaWord::Comment},
    {"!:", MetaWord::Embedded},
    {"!COLOUR", MetaWord::Colour},
    {"!AVATAR", MetaWord::Avatar},
};

QString qt(std::string_view text) { return QString::fromUtf8(text.data(), static_cast<qsizetype>(text.size())); }

std::string_view afterWord(std::string_view text)
{
    const auto end = text.find(' ', 2);
    return end == std::string_view::npos ? std::string_view() : text.substr(end);
}

// The words after the line's first word.
std::size_t wordCount(std::string_view rest)
{
    std::size_t count = 0;
    for (std::size_t i = 0; i < rest.size(); ++i)
        count += rest[i] == ' ' && i + 1 < rest.size() ? 1 : 0;
    return count;
}

std::string_view wordAt(std::string_view rest, std::size_t index)
{
    std::size_t start = 0;
    for (std::size_t i = 0; i <= index; ++i)
        start = rest.find(' ', start) + 1;
    return rest.substr(start, rest.find(' ', start) - start);
}

bool equalsIgnoringCase(std::string_view a, std::string_view b)
{
    if (a.size() != b.size())
        return false;
    for (std::size_t i = 0; i < a.size(); ++i)
        if ((a[i] | 0x20) != (b[i] | 0x20))
            return false;
    return true;
}

// "0 Name:" and one word, the blank after the colon optional.
bool validName(std::string_view text)
{
    auto rest = text.substr(7);
    if (!rest.empty() && rest[0] == ' ')
        rest.remove_prefix(1);
    return !rest.empty() && rest.find(' ') == std::string_view::npos;
}

// "0 Author:", an optional real name without "[", an optional "[user]".
bool validAuthor(std::string_view text)
{
    const auto open = text.find('[');
    if (open == std::string_view::npos)
        return true;
    const auto user = text.substr(open + 1);
    return user.size() >= 2 && user.back() == ']' &&
           user.find_first_not_of("ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789_.-") ==
               user.size() - 1;
}

bool validBfc(std::string_view rest)
{
    const auto count = wordCount(rest);
    if (count < 1 || count > 2)
        return false;
    const auto command = wordAt(rest, 0);
    bool known = false;
    for (const auto name : {"NOCERTIFY", "CERTIFY", "CW", "CCW", "CLIP", "NOCLIP", "INVERTNEXT"})
        known = known || equalsIgnoringCase(command, name);
    if (!known || count == 1)
        return known;
    const auto winding = wordAt(rest, 1);
    return (command == "CERTIFY" || command == "CLIP") &&
           (equalsIgnoringCase(winding, "CW") || equalsIgnoringCase(winding, "CCW"));
}

bool validPreview(std::string_view rest)
{
    if (wordCount(rest) != 13)
        return false;
    const auto colour = wordAt(rest, 0);
    for (std::size_t i = 0; i < colour.size(); ++i)
        if (colour[i] < '0' || colour[i] > '9')
            return false;
    for (std::size_t i = 1; i < 13; ++i)
        if (!IsTrackerNumber(wordAt(rest, i)))
            return false;
    return true;
}

bool validLDrawOrg(std::string_view text)
{
    static const Pattern configuration("^0 !LDRAW_ORG Configuration UPDATE \\d{4}-\\d{2}-\\d{2}", Unicode);
    const auto line = qt(text);
    return IsPartTypeLine(line) || configuration.match(line).hasMatch();
}

bool validTexMap(std::string_view text)
{
    static const Pattern shape("^0 !TEXMAP (?:START|NEXT|FALLBACK|END)(?: (?:PLANAR|CYLINDRICAL|SPHERICAL)"
                               "(?: [-+]?(?:\\d+|\\d*\\.\\d+)){9,11} \\S+\\.png(?: GLOSSMAP \\S+\\.png)?)?$",
                               Unicode);
    return shape.match(qt(text)).hasMatch();
}

// A category, a description, a placement of nine numbers and the file shown.
bool validAvatar(std::string_view text)
{
    static const Pattern shape("^0 !AVATAR CATEGORY \"[^\"]+\" DESCRIPTION \"[^\"]+\" PART(?: -?\\d+(?:\\.\\d+)?){9} "
                               "\"[^\"]+\"$");
    return shape.match(qt(text)).hasMatch();
}

} // namespace

MetaWord MetaWordOf(std::string_view text)
{
    const auto word = text.substr(2, text.find(' ', 2) - 2);
    if (word.substr(0, 5) == "Name:")
        return MetaWord::Name;
    if (word.substr(0, 7) == "Author:")
        return MetaWord::Author;
    for (const auto& [name, kind] : Words)
        if (word == name)
            return kind;
    return MetaWord::Other;
}

bool IsValidMetaLine(std::string_view text, MetaWord word, bool firstLine)
{
    const auto rest = afterWord(text);
    switch (word) {
    case MetaWord::Name: return validName(text);
    case MetaWord::Author: return validAuthor(text);
    case MetaWord::LDrawOrg: return validLDrawOrg(text);
    case MetaWord::License:
    case MetaWord::Help:
    case MetaWord::Category:
    case MetaWord::Keywords:
    case MetaWord::CmdLine:
    case MetaWord::Comment: return !rest.empty();
    case MetaWord::Bfc: return validBfc(rest);
    case MetaWord::Preview: return validPreview(rest);
    case MetaWord::History: return IsHistoryLine(qt(text));
    case MetaWord::TexMap: return validTexMap(text);
    case MetaWord::Embedded: {
        GeometryLine line;
        return ReadGeometryLine(EmbeddedLine(text), line);
    }
    case MetaWord::Colour: return ColourDefinitionCode(text).has_value();
    case MetaWord::Avatar: return validAvatar(text);
    case MetaWord::Other: return firstLine;
    }
    return false;
}

bool IsHeaderMetaLine(std::string_view text, MetaWord word, bool firstLine)
{
    switch (word) {
    case MetaWord::Name:
    case MetaWord::Author:
    case MetaWord::License:
    case MetaWord::Help:
    case MetaWord::Category:
    case MetaWord::Keywords:
    case MetaWord::CmdLine:
    case MetaWord::Preview:
    case MetaWord::History: return true;
    case MetaWord::LDrawOrg: {
        auto type = wordAt(afterWord(text), 0);
        if (type.substr(0, 11) == "Unofficial_")
            type.remove_prefix(11);
        return KnownPartTypes.contains(qt(type));
    }
    case MetaWord::Bfc: {
        const auto command = wordAt(afterWord(text), 0);
        return command == "CERTIFY" || command == "NOCERTIFY";
    }
    case MetaWord::Embedded: return false;
    default: return firstLine;
    }
}

std::string_view EmbeddedLine(std::string_view text) { return text.size() > 5 ? text.substr(5) : std::string_view(); }

std::optional<long> ColourDefinitionCode(std::string_view text)
{
    // A material's parameters: its kind, then each of the others at most once and in this order.
    static const QString hex = "(?:0x|#)[0-9A-Fa-f]{6}", byte = "(?:25[0-5]|2[0-4]\\d|1?\\d{1,2})",
                         fraction = "(?:0|0\\.\\d+|1|1\\.0+)", size = "(?:[1-9]\\d*(?:\\.\\d+)?|0?\\.\\d*[1-9]\\d*)";
    static const QString material = "(?:GLITTER|SPECKLE|FABRIC)(?: VALUE " + hex + ")?(?: ALPHA " + byte +
                                    ")?(?: LUMINANCE " + byte + ")?(?: FRACTION " + fraction + ")?(?: VFRACTION " +
                                    fraction + ")?(?: SIZE " + size + ")?(?: MINSIZE " + size + " MAXSIZE " + size +
                                    ")?(?: (?:VELVET|CANVAS|STRING|FUR))?";
    static const Pattern shape("^0 !COLOUR [A-Za-z0-9_]+ CODE (\\d+) VALUE " + hex + " EDGE (?:\\d+|" + hex +
                               ")(?: ALPHA " + byte + ")?(?: LUMINANCE " + byte +
                               ")?(?: (?:CHROME|PEARLESCENT|RUBBER|MATTE_METALLIC|METAL|MATERIAL))*(?: MATERIAL " +
                               material + ")?$");
    const auto match = shape.match(qt(text));
    if (!match.hasMatch())
        return std::nullopt;
    bool ok = false;
    const auto code = match.captured(1).toLong(&ok);
    return ok ? std::optional<long>(code) : std::nullopt;
}

bool IsPartTypeLine(const QString& text)
{
    static const Pattern partType("^0 !LDRAW_ORG (?:Unofficial_)?(?:" + KnownPartTypes.join('|') +
                                      ")(?: (?:Alias|Physical_Colour|Flexible_Section))?"
                                      "(?: (?:ORIGINAL|UPDATE \\d{4}-\\d{2}))?$",
                                  Unicode);
    return partType.match(text).hasMatch();
}

bool IsHistoryLine(const QString& line)
{
    static const Pattern shape("^0\\h+!HISTORY\\h+\\d{4}-\\d{2}-\\d{2}\\h+(?:\\[[A-Za-z0-9_.-]+\\]|\\{[^}]+\\})\\h+\\S",
                               Unicode);
    return shape.match(line).hasMatch();
}
