#include "FixUps.h"

#include "LineEnds.h"
#include "SplitText.h"
#include "Text.h"

bool HasCertifyInvertNext(std::string_view body) { return ContainsIgnoreCase(body, "0 BFC CERTIFY INVERTNEXT"); }

void FixCertifyInvertNext(std::string& body)
{
    body = ReplaceAll(body, "0 BFC CERTIFY INVERTNEXT", "0 BFC INVERTNEXT");
}

bool HasRotationLines(std::string_view body) { return ContainsIgnoreCase(body, "0 ROTATION "); }

void DeleteRotationLines(std::string& body)
{
    std::string kept;
    for (const auto& line : SplitText(body, CrLf)) {
        if (line.compare(0, 11, "0 ROTATION ") == 0)
            continue;
        if (!kept.empty())
            kept += CrLf;
        kept += line;
    }
    body = std::move(kept);
}

bool HasWriteLines(std::string_view body) { return ContainsIgnoreCase(body, "0 WRITE "); }

void RemoveWriteKeywords(std::string& body) { body = ReplaceAll(body, "0 WRITE", "0"); }

bool HasColorLines(const HeaderData& header) { return !header.ColorLines.empty(); }

void ClearColorLines(HeaderData& header) { header.ColorLines.clear(); }
