// SPDX-License-Identifier: MIT
#pragma once

#include <initializer_list>
#include <memory>
#include <string>
#include <string_view>

#include "NewFile.h"
#include "OpenPart.h"
#include "QmError.h"

// A file that must keep its inode is rewritten in place. Before that, a keep file takes a whole
// copy of its old bytes and of the new text, on disk, with the identity of the file it keeps
// (device, inode, birth time). It is named after device and inode, so that any later open finds it
// with one look whatever the file's name, and it stands in the part's folder, or where this user
// may not create files there, in a folder of his own (KeepFolderIn). The writer holds a lock on it
// for the whole rewrite: a keep file that can be locked was left by a writer that is gone.

// The home folder of the user this program runs as, from the password database (never from the
// environment); empty when he has none.
const std::string& HomeOfThisUser();

// The writer's keep file, removed when it goes unless kept.
class KeepFile {
public:
    KeepFile(const OpenPart& part, std::string_view oldBytes, std::initializer_list<std::string_view> newText,
             const std::string& home);
    ~KeepFile();
    KeepFile(const KeepFile&) = delete;
    KeepFile& operator=(const KeepFile&) = delete;
    // Leaves the keep file for the next open or save: the one whole copy of the old bytes.
    void keep() { kept_ = true; }
    // Where it stands: the part's folder, or this user's own.
    const OpenFolder& folder() const { return *folder_; }

private:
    std::shared_ptr<const OpenFolder> folder_;
    std::string name_;
    std::unique_ptr<NewFile> file_; // holds the lock
    bool kept_ = false;
};

// What a keep file left for a part says, looked at without writing anything.
struct KeepFinding {
    enum class State {
        None,       // no keep file stands for the part
        Busy,       // its writer is still at work
        Untouched,  // the part still holds the old bytes
        Finished,   // the part holds the whole new text: the rewrite ended
        Restorable, // the part holds what an interrupted rewrite leaves: the old bytes go back
        Changed,    // the part holds something else: a later change
        Orphan,     // this user's copy of a file that is gone: another file has its inode now
        OthersCopy, // another user's copy, never applied: it may hold anything he likes
    };
    State state = State::None;
    std::string keepPath;
    std::string oldBytes;          // when Restorable
    bool tornByOthersSave = false; // OthersCopy: his killed save left the part torn
};
KeepFinding ExamineKeepFile(const OpenPart& part, const std::string& home);

// ExamineKeepFile for the parts a run only reads, at the cost of one look per run: this user's own
// keep folder is opened and listed once, and a part folder that a walk listed is looked in only
// for the keep names the walk saw. Shared by the run's threads.
class KeepSearch {
public:
    explicit KeepSearch(const std::string& home = HomeOfThisUser());
    KeepFinding examine(const OpenPart& part) const;

private:
    std::shared_ptr<const OpenFolder> own_;
};

// A keep file stands for a part only when this user made it (it is his, and nobody else may write
// it); another user's is reported (OthersCopy) and never read into the part.
// True when a keep file of the part's name exists, this user's or another's: a look at its name,
// nothing read.
bool HasKeepFile(const OpenPart& part, const std::string& home);

// A keep file that stays because the part changed since the interrupted save.
class KeepNotRestoredError : public QmError {
public:
    KeepNotRestoredError(const std::string& path, const std::string& keepPath);
};

// The one line that says this user's copy of a file that is gone was found and left alone.
std::string OrphanCopyNotice(const std::string& keepPath);
// The one line that says another user's copy was found and left alone.
std::string OthersCopyNotice(const std::string& path, const KeepFinding& finding);

// Acts on what ExamineKeepFile finds, under the part's lock: writes the old bytes back through the
// part's descriptor when the part is Restorable, removes the keep file when it no longer
// applies, throws KeepNotRestoredError when the part Changed and FileLockedError while another
// process holds the keep file. An Orphan or another user's copy is left as it is and never stops
// a save. Returns what it found (Restorable: the old bytes went back).
KeepFinding RestoreInterruptedRewrite(const OpenPart& part, const std::string& home);

// The keep-file name of the file with this device and inode; for folder runs that report keep
// files whose part is gone.
bool IsKeepFileName(std::string_view name, unsigned long long& device, unsigned long long& inode);
