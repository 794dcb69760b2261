#pragma once

#include <functional>
#include <initializer_list>
#include <optional>
#include <string>
#include <string_view>

// The path a save writes to: path with the symbolic links at its end followed, so that saving
// through a link changes the file it points to and the link stays a link. A path that is no
// link comes back as it is.
std::string ResolveLinks(const std::string& path);

// The points between the steps of a replace, where a test can stop a save as a kill would.
enum class ReplaceStep { NewTextWritten, BackupMade, NewTextNamed, Placed };
using ReplaceStepHook = std::function<void(ReplaceStep)>;

// Replaces the content of the file at path (links followed) by the pieces, one after the other,
// so that the file is never broken, never missing and never another user's:
// - the new text goes to a temporary file in the same folder that has no name until it is
//   complete and on disk, and then takes the file's name in one rename;
// - a file with several hard links, one whose owner a new file could not keep, or one in a folder
//   where this user may not create files, is rewritten in place instead, after a copy of its old
//   bytes is safe on disk, and restored from that copy if writing fails;
// - with a backup path, the old content ends under that name (a second name for the old file,
//   or a copy of it);
// - a file this user may not write, or that has no write permission at all, is refused.
// On any failure the file keeps its old content, nothing else is left behind, and QmError is
// thrown.
void ReplaceFileSafely(const std::string& path, std::initializer_list<std::string_view> pieces,
                       const std::optional<std::string>& backupPath, const ReplaceStepHook& afterStep = {});
