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

// The range of a finding in the document: the bytes it is about (the number, the word, the value),
// else the whole line; the first line for a finding about the file as a whole.
nlohmann::json FindingRangeJson(const Document& document, const FileFinding& finding, PositionEncoding encoding);

// The diagnostic of a finding of the document: its range, its id as code, its severity, source
// "quillmark".
nlohmann::json DiagnosticJson(const Document& document, const FileFinding& finding, PositionEncoding encoding);

// The protocol's line (from 0) a finding starts on.
std::size_t LineOfFinding(const Document& document, const FileFinding& finding);
