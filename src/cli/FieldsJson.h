// SPDX-License-Identifier: MIT
#pragma once

#include <string>

#include "HeaderData.h"

// A path or a file's text for JSON: as it is when its bytes are valid UTF-8, else each byte as
// the character of that code (ISO-8859-1). Either way the bytes can be recovered.
std::string TextForJson(const std::string& path);

// The record as one line of JSON. Each byte of text becomes the character with that code
// (ISO-8859-1), so the JSON is valid whatever the file holds and every byte can be recovered;
// the two paths are as TextForJson gives them.
std::string FieldsJson(const HeaderData& header);
