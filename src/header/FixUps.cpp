// SPDX-License-Identifier: MIT
#include "FixUps.h"

#include "LineEnds.h"
#include "Text.h"

namespace {

constexpr std::string_view RotationStart = "0 ROTATION ";
constexpr std::string_view WriteStart = "0 WRITE";

bool isRotationLine(std::string_view line) { return StartsWithIgnoreCase(line, RotationStart); }

// "0 WRITE" as a word of its own at the start of the line ("0 WRITES" is another word).
bool isWriteLine(std::string_view line)
{
    return StartsWithIgnoreCase(line, WriteStart) &&
           (line.size() == WriteStart.size() || line[WriteStart.size()] == ' ');
}

// Calls visit with each line of the body, the lines being separated by CR LF.
template <typename Visit>
void forEachLine(std::string_view body, Visit&& visit)
{
    for (std::size_t start = 0;;) {
        const auto end = body.find(CrLf, start);
        visit(body.substr(start, end == std::string_view::npos ? end : end - start));
        if (end == std::string_view::npos)
            return;
        start = end + CrLf.size();
    }
}

bool anyLine(std::string_view body, bool (*matches)(std::string_view))
{
    bool found = false;
    forEachLine(body, [&](std::string_view line) { found = found || matches(line); });
    return found;
}

} // namespace

bool HasCertifyInvertNext(std::string_view body) { return ContainsIgnoreCase(body, "0 BFC CERTIFY INVERTNEXT"); }

void FixCertifyInvertNext(std::string& body)
{
    body = ReplaceAll(body, "0 BFC CERTIFY INVERTNEXT", "0 BFC INVERTNEXT");
}

bool HasRotationLines(std::string_view body) { return anyLine(body, isRotationLine); }

void DeleteRotationLines(std::string& body)
{
    std::string kept;
    kept.reserve(body.size());
    forEachLine(body, [&kept](std::string_view line) {
        if (isRotationLine(line))
            return;
        if (!kept.empty())
            kept += CrLf;
        kept += line;
    });
    body = std::move(kept);
}

bool HasWriteLines(std::string_view body) { return anyLine(body, isWriteLine); }

void RemoveWriteKeywords(std::string& body)
{
    std::string fixed;
    fixed.reserve(body.size());
    bool first = true;
    forEachLine(body, [&](std::string_view line) {
        if (!first)
            fixed += CrLf;
        first = false;
        if (isWriteLine(line)) {
            fixed += '0';
            line.remove_prefix(WriteStart.size());
        }
        fixed += line;
    });
    body = std::move(fixed);
}

bool HasColorLines(const HeaderData& header) { return !header.ColorLines.empty(); }

void ClearColorLines(HeaderData& header) { header.ColorLines.clear(); }
