// SPDX-License-Identifier: MIT
#pragma once

#include "BodyFixes.h"
#include "Clock.h"
#include "HeaderData.h"

// Repairs of the Parts Tracker's findings on a part's header fields; the composer then writes the
// header as for any edit.

struct HeaderFixContext {
    const StringList& categories; // the list file's entries
    bool limitDescription = true; // the description's 64 characters
    LocalDateTime today;
};

// The licence the library wants for the file, as the edit "current" chooses it.
void FixLicence(HeaderData& header, const HeaderFixContext& context, FixNote& note);
// "Name:" becomes the file's name after the folder its type wants.
void FixNameFolder(HeaderData& header, const HeaderFixContext& context, FixNote& note);
// A second blank before each number the library finds after one blank in the description.
void FixDescriptionNumbers(HeaderData& header, const HeaderFixContext& context, FixNote& note);
// " Pattern" at the end of a pattern's description.
void FixPatternWord(HeaderData& header, const HeaderFixContext& context, FixNote& note);
// A retired category replaced by the active one that follows from it or from the description.
void FixRetiredCategory(HeaderData& header, const HeaderFixContext& context, FixNote& note);
