// SPDX-License-Identifier: MIT
#pragma once

#include <QString>
#include <QStringList>
#include <string_view>
#include <vector>

// A part file's header as the Parts Tracker reads it: the meta lines up to the first line of
// another type, as Unicode text.
struct HeaderFacts {
    QString description; // line 1 without its "0 "
    QString prefix;      // the description's leading run of "~", "_", "=" and "|"
    bool hasName = false, hasAuthor = false, hasLicense = false, hasType = false;
    QString name;      // "0 Name:" value, with its folder ("s\\3001s01.dat")
    QString author;    // "0 Author:" value
    QString license;   // "0 !LICENSE" value, runs of blanks collapsed
    QString type;      // "Part", "Unofficial_Subpart", ...
    QString qualifier; // "Alias", "Flexible_Section", "Physical_Colour" or empty
    QString category;  // the first "0 !CATEGORY", otherwise the description's first word
    QStringList keywords;
    QStringList historyLines; // whole lines
    QStringList previewLines; // whole lines
    QString firstBfcLine;     // whole line
};

// Reads the header of a UTF-8 text whose lines end in CR LF.
HeaderFacts ReadHeaderFacts(std::string_view text);

// The part types the library knows, without "Unofficial_".
extern const QStringList KnownPartTypes;

// The categories the library has retired, with or without a replacement.
extern const QStringList RetiredCategories;

// A number that the library wants after two blanks but finds after one, as the blank before it
// and the number.
struct SingleBlankNumber {
    qsizetype start, length;
};
// Each in description, from its start on: a number after exactly one blank, other than a
// two-digit one, a size in inches or a fraction, "Type 2", "Phase 1", "Functions 3", or a number
// of balls, stripes or white parts.
std::vector<SingleBlankNumber> SingleBlankNumbers(const QString& description);

// Type without "Unofficial_".
QString PlainType(const QString& type);
