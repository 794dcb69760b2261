// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <string>

// A deterministic part file of lineCount lines: a real-looking header followed by geometry
// lines of types 1 to 5, CR LF line ends.
std::string GeneratePartFile(std::size_t lineCount);
