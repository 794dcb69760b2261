// SPDX-License-Identifier: MIT
#pragma once

#include <span>
#include <string>
#include <string_view>

// True when the regular file at path (links followed) holds exactly the pieces one after another.
// The file is read a piece at a time, never held whole; a file of another size is told apart
// without reading it. A file that cannot be read, or is no regular file, holds nothing alike.
bool FileHoldsExactly(const std::string& path, std::span<const std::string_view> pieces);
