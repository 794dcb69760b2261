#pragma once

#include <string>
#include <vector>

// The files a batch command works on: a file named on the command line as it is, in the order
// given; a folder as every regular file below it whose name ends in ".dat" in any case, sorted by
// path, without following links to folders.
std::vector<std::string> ExpandPartFiles(const std::vector<std::string>& arguments);
