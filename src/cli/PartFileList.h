// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <sys/types.h>
#include <vector>

#include "OpenPart.h"

// A folder (or an entry of one) that a walk could not open or read to its end, and why.
struct WalkProblem {
    std::string path;
    std::string reason;
};

// A folder a walk went through: the chain of names from the folder named on the command line,
// each with the identity the walk saw, so that the folder is found again through descriptors and
// never through a link or another folder put in its place since.
struct FolderTrail {
    std::shared_ptr<const FolderTrail> parent; // null for the folder named
    std::string name;                          // in the parent; the path of the folder named
    dev_t device = 0;
    ino_t inode = 0;
    // The folder itself, held open since the walk listed it, with the keep names it saw there; null
    // for folders beyond the number a walk holds, found again along the trail.
    std::shared_ptr<const OpenFolder> held;
};

// A file to work on: named on the command line (no trail), or found in a folder of a walk.
struct PartFileEntry {
    std::string path; // as the output names it
    std::shared_ptr<const FolderTrail> folder;
    std::string name; // in that folder
};

// The files a batch command works on, and what the walks passed over.
struct PartFileList {
    std::vector<PartFileEntry> files;
    std::vector<WalkProblem> problems;
    std::vector<std::string> orphanKeepFiles; // copies kept by interrupted saves of files now gone
    std::size_t backupsSkipped = 0;           // files whose names are backup names
    std::size_t linksSkipped = 0;             // links to folders, and links named like part files
};

// A file named on the command line is taken byte for byte, in the order given; a folder gives
// every regular file below it whose name ends in ".dat" in any case and is no backup name, sorted
// by path. A walk stays inside its folder: it follows no link below it. It holds one folder open
// at a time (two while it steps from one to the next), and no more than the path and the names
// still to visit, however deep the tree.
PartFileList ExpandPartFiles(const std::vector<std::string>& arguments);

// Opens the part an entry names: one named on the command line as OpenPart::openPath does, one
// found by a walk through the descriptors of the folders from the one named down, each of which
// must still be the folder the walk saw. Throws QmError.
std::shared_ptr<OpenPart> OpenEntry(const PartFileEntry& entry);
