// SPDX-License-Identifier: MIT
#include "LineChecks.h"

#include <cstdio>
#include <string>

#include "Geometry.h"
#include "GeometryLine.h"
#include "MetaLine.h"
#include "NumberFormats.h"
#include "TrackerText.h"

namespace {

std::string quoted(std::string_view text)
{
    std::string result;
    result.reserve(text.size() + 2);
    return result.append(1, '"').append(text).append(1, '"');
}

std::string degrees(double angle)
{
    char text[32];
    std::snprintf(text, sizeof text, "%.3f°", angle);
    return text;
}

std::array<Point, 4> pointsOf(const GeometryLine& line)
{
    std::array<Point, 4> points{};
    for (std::size_t k = 0; k < 4; ++k)
        points[k] = {line.numbers[3 * k], line.numbers[3 * k + 1], line.numbers[3 * k + 2]};
    return points;
}

void checkNumbers(std::string_view text, int number, Findings& findings)
{
    const auto found = CheckNumberFormats(text);
    if (!found.tooPrecise.empty())
        findings.error("numbers.decimalprecision",
                       "The number " + quoted(found.tooPrecise) + " has more than 5 decimal places.", number);
    if (!found.trailingZero.empty())
        findings.error("numbers.trailingzeros",
                       "The number " + quoted(found.trailingZero) + " ends in a needless zero.", number);
    if (!found.leadingZero.empty())
        findings.error("numbers.leadingzeros",
                       "The number " + quoted(found.leadingZero) + " starts with a needless zero.", number);
}

void checkColour(const GeometryLine& line, const ColourCodes& colours, int number, Findings& findings)
{
    if (!line.directColour && !colours.contains(line.colour))
        findings.error("line.invalidcolor",
                       "Colour " + std::string(line.colourText) + " is not defined in LDConfig.ldr.", number);
    const bool edgeColour = !line.directColour && line.colour == 24;
    if (line.type == 1 && edgeColour)
        findings.error("line.invalidcolor", "A subfile may not be placed in the edge colour 24.", number);
    if ((line.type == 3 || line.type == 4) && edgeColour)
        findings.error("line.invalidcolor24", "Triangles and quads may not use the edge colour 24.", number);
    if ((line.type == 2 || line.type == 5) && !edgeColour)
        findings.error(
            "line.invalidcoloredlines",
            "Lines and optional lines must use the edge colour 24, not " + std::string(line.colourText) + ".", number);
}

// The points that must differ: a line's two ends, a triangle's or quad's corners, and an optional
// line's two control points.
bool hasIdenticalPoints(const GeometryLine& line, const std::array<Point, 4>& p)
{
    switch (line.type) {
    case 2: return p[0] == p[1];
    case 3: return p[0] == p[1] || p[1] == p[2] || p[2] == p[0];
    case 4: return p[0] == p[1] || p[1] == p[2] || p[2] == p[3] || p[3] == p[0] || p[0] == p[2] || p[1] == p[3];
    case 5: return p[0] == p[1] || p[2] == p[3];
    default: return false;
    }
}

void checkQuadShape(const std::array<Point, 4>& p, int number, Findings& findings)
{
    if (!IsConvexQuad(p)) {
        findings.error("line.notconvex", "The quad is concave or crossed (a bow-tie).", number);
        return;
    }
    const auto bend = QuadBend(p);
    if (bend > 3)
        findings.error("line.notcoplaner", "The quad is not flat: it bends by " + degrees(bend) + ".", number);
    else if (bend > 1)
        findings.warning("warning.notcoplaner", "The quad is not quite flat: it bends by " + degrees(bend) + ".",
                         number);
}

void checkBodyLine(const GeometryLine& line, std::string_view text, const LinePart& part, int number,
                   Findings& findings)
{
    checkNumbers(text, number, findings);
    checkColour(line, part.colours, number, findings);
    CheckLineGeometry(line, number, findings);
}

// A file name as the Tracker compares it with the part's name: lower case (ASCII), trimmed.
bool placesItself(const GeometryLine& line, std::string_view name)
{
    if (line.file.size() != name.size())
        return false;
    for (std::size_t i = 0; i < name.size(); ++i) {
        const auto c = line.file[i];
        if ((c >= 'A' && c <= 'Z' ? c + ('a' - 'A') : c) != name[i])
            return false;
    }
    return true;
}

} // namespace

void CheckLineGeometry(const GeometryLine& line, int number, Findings& findings)
{
    if (line.type == 1) {
        if (IsSingularPlacement(line.numbers))
            findings.error("line.singular", "The subfile's placement matrix is singular.", number);
        return;
    }
    const auto points = pointsOf(line);
    if (hasIdenticalPoints(line, points)) {
        findings.error("line.identicalpoints", "Two of the line's points are the same.", number);
        return;
    }
    if (line.type != 3 && line.type != 4)
        return;
    if (const auto angle = ColinearAngle(points.data(), line.type)) {
        findings.error("line.colinear", "The points lie (nearly) on one line: a corner of " + degrees(*angle) + ".",
                       number);
        return;
    }
    if (line.type == 4)
        checkQuadShape(points, number, findings);
}

namespace {

// Reads each line's shape; hands the body's valid geometry to the rules.
class LineReader {
public:
    LineReader(const LinePart& part, Findings& findings) : part_(part), findings_(findings) { buffer_.reserve(256); }

    void read(const TrackerLine& line)
    {
        text_ = line.plain ? line.text : CollapseBlanks(line.text, buffer_);
        const bool geometry = text_[0] >= '1' && text_[0] <= '5';
        const bool meta = text_.size() > 2 && text_[0] == '0' && text_[1] == ' ';
        const auto word = meta ? MetaWordOf(text_) : MetaWord::Other;
        inBody_ = inBody_ || !meta || !IsHeaderMetaLine(text_, word, line.first);
        GeometryLine shape;
        const bool valid = geometry ? ReadGeometryLine(text_, shape) : meta && IsValidMetaLine(text_, word, line.first);
        if (!valid)
            findings_.error("line.invalid", "Not a valid LDraw line: " + quoted(text_), line.number);
        else if (geometry)
            readGeometry(shape, line.number);
        else if (word == MetaWord::Embedded && inBody_ && ReadGeometryLine(EmbeddedLine(text_), shape))
            checkBodyLine(shape, text_, part_, line.number, findings_);
    }

    void finish()
    {
        if (placesItself_)
            findings_.error("circularreference", "The file places itself as a subfile.");
        if (stickerInColour_)
            findings_.warning("warning.stickercolor",
                              "The sticker shortcut places a sticker in a colour other than 16: make sure it goes "
                              "on a surface meant to be transparent.");
    }

private:
    void readGeometry(const GeometryLine& shape, int number)
    {
        checkBodyLine(shape, text_, part_, number, findings_);
        if (shape.type != 1)
            return;
        placesItself_ = placesItself_ || placesItself(shape, part_.name);
        stickerInColour_ = stickerInColour_ || (part_.stickerShortcut && (shape.directColour || shape.colour != 16));
    }

    const LinePart& part_;
    Findings& findings_;
    std::string buffer_;
    std::string_view text_; // the current line, blanks collapsed
    bool inBody_ = false, placesItself_ = false, stickerInColour_ = false;
};

} // namespace

void CheckLines(std::string_view text, const LinePart& part, Findings& findings)
{
    LineReader reader(part, findings);
    TrackerLines lines(text);
    for (TrackerLine line; lines.next(line);)
        if (!line.text.empty())
            reader.read(line);
    reader.finish();
}
