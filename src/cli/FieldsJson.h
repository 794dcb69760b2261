// SPDX-License-Identifier: MIT
#pragma once

#include <string>

#include "HeaderData.h"

// A path or a file's text for JSON: as it is when its bytes are valid UTF-8, else each byte as
// the character of that code (ISO-8859-1). Either way the bytes can be recovered.
std::string TextForJson(const std::string& path);

// A header text of a file for JSON: the characters of a file that is valid UTF-8, each byte as
// the ISO-8859-1 character of that code for any other; the window shows the file the same way.
std::string HeaderTextForJson(std::string_view text, TextEncoding encoding);

// The record as one line of JSON: header texts as HeaderTextForJson gives them, the two paths
// as TextForJson.
std::string FieldsJson(const HeaderData& header);
