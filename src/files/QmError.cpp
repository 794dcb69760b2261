// SPDX-License-Identifier: MIT
#include "QmError.h"

#include <cerrno>
#include <new>
#include <sys/stat.h>

#include "Folders.h"

namespace {

bool folderOfPathExists(const std::string& path)
{
    struct stat info {};
    return ::stat(FolderOf(path).c_str(), &info) == 0 && S_ISDIR(info.st_mode);
}

} // namespace

QmError::QmError(int number, std::string description)
    : std::runtime_error(description), number_(number), description_(std::move(description))
{
}

QmError InvalidCallError() { return {ErrorNumber::InvalidCall, "Invalid procedure call or argument"}; }

QmError ErrorOf(const std::exception& failure)
{
    if (const auto* known = dynamic_cast<const QmError*>(&failure))
        return *known;
    if (dynamic_cast<const std::bad_alloc*>(&failure) != nullptr)
        return OutOfMemoryError();
    return {51, "Internal error"};
}

QmError InputPastEndOfFileError() { return {ErrorNumber::InputPastEndOfFile, "Input past end of file"}; }

QmError OutOfMemoryError() { return {ErrorNumber::OutOfMemory, "Out of memory"}; }

QmError PathFileAccessError() { return {ErrorNumber::PathFileAccessError, "Path/File access error"}; }

QmError OsError(int errnoValue, const std::string& path)
{
    switch (errnoValue) {
    case ENOENT:
        if (folderOfPathExists(path))
            return {ErrorNumber::FileNotFound, "File not found"};
        return {ErrorNumber::PathNotFound, "Path not found"};
    case ENOTDIR: return {ErrorNumber::PathNotFound, "Path not found"};
    case EEXIST: return {ErrorNumber::FileAlreadyExists, "File already exists"};
    case EACCES:
    case EPERM:
    case EROFS: return {ErrorNumber::PermissionDenied, "Permission denied"};
    case ENOSPC:
    case EDQUOT: return {ErrorNumber::DiskFull, "Disk full"};
    case EIO: return {ErrorNumber::DeviceIoError, "Device I/O error"};
    default: return PathFileAccessError();
    }
}
