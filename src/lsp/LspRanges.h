// SPDX-License-Identifier: MIT
#pragma once

#include <nlohmann/json.hpp>
#include <vector>

#include "Documents.h"
#include "FileFindings.h"

// Findings and places of a document in the protocol's terms.

nlohmann::json PositionJson(TextPosition position);
// A position from its JSON; nullopt when it is not one.
std::optional<TextPosition> PositionFromJson(const nlohmann::json& json);

// The range of a whole line's content (without its line end).
nlohmann::json LineRangeJson(const Document& document, std::size_t line, PositionEncoding encoding);

// The diagnostic of a finding of the document: the range of the line it is about (the first
// line for one about the file as a whole), its id as code, its severity, source "quillmark".
nlohmann::json DiagnosticJson(const Document& document, const FileFinding& finding, PositionEncoding encoding);

// The protocol's line (from 0) of a finding.
std::size_t LineOfFinding(const FileFinding& finding);
