#pragma once

#include <string>

#include "HeaderData.h"

// A path for JSON: as it is when its bytes are valid UTF-8, else each byte as the character of
// that code (ISO-8859-1). Either way the path's bytes can be recovered.
std::string PathForJson(const std::string& path);

// The record as one line of JSON. Each byte of text becomes the character with that code
// (ISO-8859-1), so the JSON is valid whatever the file holds and every byte can be recovered;
// the two paths are as PathForJson gives them.
std::string FieldsJson(const HeaderData& header);
