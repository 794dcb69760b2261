// SPDX-License-Identifier: MIT
#pragma once

#include <string>

// The folder a path's file stands in, as the file system takes it: "." for a bare name, "/" for a
// file in the root.
std::string FolderOf(const std::string& path);
