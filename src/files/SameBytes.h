// SPDX-License-Identifier: MIT
#pragma once

#include <span>
#include <string_view>

// True when the open regular file fd holds exactly the pieces one after another. The file is read
// a piece at a time, never held whole; a file of another size is told apart without reading it.
// A file that cannot be read, or is no regular file, holds nothing alike.
bool FileHoldsExactly(int fd, std::span<const std::string_view> pieces);
