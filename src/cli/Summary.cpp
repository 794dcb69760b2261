// SPDX-License-Identifier: MIT
#include "Summary.h"

void Summary::addWalks(const PartFileList& found)
{
    unreadable_ += found.problems.size();
    backupsSkipped_ += found.backupsSkipped;
    linksSkipped_ += found.linksSkipped;
}

void Summary::add(const FileReport& report)
{
    ++files_;
    if (report.unreadable) {
        ++unreadable_;
        return;
    }
    refused_ += report.refused || !report.refusals.empty() ? 1 : 0;
    for (const auto& reason : report.refusals)
        ++reasons_[reason];
    missingUserName_ += report.missingUserName ? 1 : 0;
    for (const auto& [offered, what, id] : FixUpNames(report.fixups))
        if (offered)
            ++fixups_[what];
    for (const auto& id : report.trackerIds)
        ++trackerIds_[id];
    saving_ = saving_ || report.saving != FileReport::Saving::NotAsked;
    saved_ += report.saving == FileReport::Saving::Saved ? 1 : 0;
    previewed_ += report.saving == FileReport::Saving::Previewed ? 1 : 0;
    unchanged_ += report.saving == FileReport::Saving::Unchanged ? 1 : 0;
    skipped_ += report.saving == FileReport::Saving::Skipped ? 1 : 0;
    failed_ += report.saving == FileReport::Saving::Failed ? 1 : 0;
}

namespace {

// "1 file", "2 files".
std::string counted(std::size_t count, const char* one, const char* many)
{
    return std::to_string(count) + ' ' + (count == 1 ? one : many);
}

} // namespace

void Summary::print(std::ostream& err) const
{
    err << counted(files_, "file", "files") << ", " << refused_ << " refused, " << missingUserName_
        << " without user name, " << unreadable_ << " unreadable";
    if (backupsSkipped_ > 0)
        err << ", " << counted(backupsSkipped_, "backup", "backups") << " skipped";
    if (linksSkipped_ > 0)
        err << ", " << counted(linksSkipped_, "link", "links") << " skipped";
    if (saving_)
        err << "; " << saved_ << " saved, " << (previewed_ > 0 ? std::to_string(previewed_) + " would be saved, " : "")
            << unchanged_ << " unchanged, " << skipped_ << " skipped, " << failed_ << " failed";
    err << '\n';
    for (const auto& [reason, count] : reasons_)
        err << "  refused (" << count << "): " << reason << '\n';
    for (const auto& [what, count] : fixups_)
        err << "  fix-up offered (" << count << "): " << what << '\n';
    for (const auto& [id, count] : trackerIds_)
        err << "  tracker " << id << " (" << count << ")\n";
}
