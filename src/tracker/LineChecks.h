// SPDX-License-Identifier: MIT
#pragma once

#include <string_view>

#include "ColourCodes.h"
#include "Findings.h"
#include "GeometryLine.h"

// What the line rules need to know about the part beyond its lines.
struct LinePart {
    const ColourCodes& colours;
    std::string_view name;        // the "0 Name:" value as written, UTF-8
    bool stickerShortcut = false; // a parts-type file in category "Sticker Shortcut"
};

// The Parts Tracker's rules on a part's lines, over its UTF-8 text: every line's shape, and the
// numbers, colours and geometry of the body's lines; also whether the part places itself.
void CheckLines(std::string_view text, const LinePart& part, Findings& findings);

// The geometry rules on one valid line of type 1 to 5: a singular placement; identical or colinear
// points; a concave, crossed or bent quad.
void CheckLineGeometry(const GeometryLine& line, int number, Findings& findings);
