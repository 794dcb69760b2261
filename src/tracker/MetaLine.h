// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <optional>
#include <string_view>

// Lines of type 0 as the Parts Tracker reads them: the word after "0 " decides the shape the
// whole line must have. Every text here is a line trimmed and with its runs of blanks collapsed
// to one space.

enum class MetaWord {
    Name,
    Author,
    LDrawOrg,
    License,
    Help,
    Category,
    Keywords,
    CmdLine,
    Bfc,
    Preview,
    History,
    TexMap,
    Comment,
    Embedded,
    Colour,
    Avatar,
    Other
};

MetaWord MetaWordOf(std::string_view text);

// True when text has the shape its word asks for; a line of another word is valid only as the
// Tracker's line 1 (the description).
bool IsValidMetaLine(std::string_view text, MetaWord word, bool firstLine);

// True when the line belongs to the header, whatever its shape: a meta line of the header's
// words, a "!LDRAW_ORG" line naming a part type, or a "BFC CERTIFY" or "BFC NOCERTIFY" line.
bool IsHeaderMetaLine(std::string_view text, MetaWord word, bool firstLine);

// "0 !LDRAW_ORG" and a part type the library knows, read as a whole: a type with its optional
// "Unofficial_", qualifier and release.
bool IsPartTypeLine(const QString& text);

// "0 !: <line>": the line embedded after the marker.
std::string_view EmbeddedLine(std::string_view text);

// The code a "0 !COLOUR" line of the LDConfig.ldr shape defines; none for a line of another shape.
std::optional<long> ColourDefinitionCode(std::string_view text);

// "0 !HISTORY YYYY-MM-DD [user] comment" or "{Real Name}" for the user; blanks of any width.
bool IsHistoryLine(const QString& line);
