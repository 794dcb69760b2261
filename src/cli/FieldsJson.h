#pragma once

#include <string>

#include "HeaderData.h"

// The record as one line of JSON. Each byte of text becomes the character with that code
// (ISO-8859-1), so the JSON is valid whatever the file holds and every byte can be recovered.
std::string FieldsJson(const HeaderData& header);
