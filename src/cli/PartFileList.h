// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <string>
#include <vector>

// A folder (or an entry of one) that a walk could not open or read to its end, and why.
struct WalkProblem {
    std::string path;
    std::string reason;
};

// The files a batch command works on, and what the walks passed over.
struct PartFileList {
    std::vector<std::string> files;
    std::vector<WalkProblem> problems;
    std::size_t backupsSkipped = 0; // files whose names are backup names
    std::size_t linksSkipped = 0;   // links to folders, and links named like part files
};

// A file named on the command line is taken byte for byte, in the order given; a folder gives
// every regular file below it whose name ends in ".dat" in any case and is no backup name, sorted
// by path. A walk stays inside its folder: it follows no link below it. It holds one descriptor at
// a time and no more than the path and the names still to visit, however deep the tree.
PartFileList ExpandPartFiles(const std::vector<std::string>& arguments);
