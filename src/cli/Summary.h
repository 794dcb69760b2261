// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <map>
#include <ostream>
#include <string>

#include "FileReport.h"
#include "PartFileList.h"

// The counts at the end of a batch: files, refusals by reason, missing user names, fix-ups
// offered, unreadable files and folders, what the folder walks passed over, and for save what
// was saved (or would be, in a dry run), left unchanged, skipped and failed.
class Summary {
public:
    void addWalks(const PartFileList& found);
    void add(const FileReport& report);
    void print(std::ostream& err) const;

private:
    std::size_t files_ = 0, refused_ = 0, missingUserName_ = 0, unreadable_ = 0;
    std::size_t backupsSkipped_ = 0, linksSkipped_ = 0;
    std::size_t saved_ = 0, previewed_ = 0, unchanged_ = 0, skipped_ = 0, failed_ = 0;
    std::map<std::string, std::size_t> reasons_;
    std::map<std::string, std::size_t> fixups_;
    std::map<std::string, std::size_t> trackerIds_;
    bool saving_ = false;
};
