// SPDX-License-Identifier: MIT
#pragma once

#include <string>

#include "HeaderData.h"

// The header text that saving writes in front of the body, composed from the record in its
// fixed line order, each line ending in CR LF, each non-empty group followed by one blank line.
std::string ComposeHeader(const HeaderData& header);
