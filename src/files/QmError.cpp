// SPDX-License-Identifier: MIT
#include "QmError.h"

#include <cerrno>
#include <new>
#include <sys/stat.h>
#include <system_error>

#include "Folders.h"

namespace {

bool folderOfPathExists(const std::string& path)
{
    struct stat info {};
    return ::stat(FolderOf(path).c_str(), &info) == 0 && S_ISDIR(info.st_mode);
}

// The system's own words for an errno value ("No such file or directory"), safe on any thread.
std::string systemReason(int errnoValue) { return std::generic_category().message(errnoValue); }

} // namespace

QmError::QmError(int number, std::string description, std::string detail)
    : std::runtime_error(description), number_(number), description_(std::move(description)), detail_(std::move(detail))
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

QmError PathFileAccessError(std::string detail)
{
    return {ErrorNumber::PathFileAccessError, "Path/File access error", std::move(detail)};
}

QmError NoRegularFileError(const std::string& path, bool folder)
{
    return PathFileAccessError(path + ": " + (folder ? systemReason(EISDIR) : std::string("Not a regular file")));
}

namespace {

QmError classicErrorOf(int errnoValue, const std::string& path)
{
    auto detail = path + ": " + systemReason(errnoValue);
    switch (errnoValue) {
    case ENOENT:
        if (folderOfPathExists(path))
            return {ErrorNumber::FileNotFound, "File not found", std::move(detail)};
        return {ErrorNumber::PathNotFound, "Path not found", std::move(detail)};
    case ENOTDIR: return {ErrorNumber::PathNotFound, "Path not found", std::move(detail)};
    case EEXIST: return {ErrorNumber::FileAlreadyExists, "File already exists", std::move(detail)};
    case EACCES:
    case EPERM: return {ErrorNumber::PermissionDenied, "Permission denied", std::move(detail)};
    case ENOSPC:
    case EDQUOT: return {ErrorNumber::DiskFull, "Disk full", std::move(detail)};
    case EIO: return {ErrorNumber::DeviceIoError, "Device I/O error", std::move(detail)};
    default: return PathFileAccessError(std::move(detail)); // a read-only file system among them
    }
}

} // namespace

QmError OsError(int errnoValue, const std::string& path)
{
    auto error = classicErrorOf(errnoValue, path);
    error.systemError_ = errnoValue;
    return error;
}

std::string ReasonInWords(int errnoValue)
{
    auto words = systemReason(errnoValue);
    if (!words.empty() && words[0] >= 'A' && words[0] <= 'Z')
        words[0] = static_cast<char>(words[0] - 'A' + 'a');
    return words;
}
