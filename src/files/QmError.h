// SPDX-License-Identifier: MIT
#pragma once

#include <stdexcept>
#include <string>

// A failure with the classic error number and description that the error reports show.
class QmError : public std::runtime_error {
public:
    // detail names what failed and the system's reason ("/parts/x.dat: Is a directory"); empty
    // where there is no file to name.
    QmError(int number, std::string description, std::string detail = {});

    int number() const { return number_; }
    const std::string& description() const { return description_; }
    const std::string& detail() const { return detail_; }
    // The system's error (errno) behind it; 0 when it came from elsewhere.
    int systemError() const { return systemError_; }

private:
    friend QmError OsError(int errnoValue, const std::string& path);
    int number_;
    std::string description_;
    std::string detail_;
    int systemError_ = 0;
};

namespace ErrorNumber {
inline constexpr int InvalidCall = 5;
inline constexpr int OutOfMemory = 7;
inline constexpr int SubscriptOutOfRange = 9;
inline constexpr int FileNotFound = 53;
inline constexpr int DeviceIoError = 57;
inline constexpr int FileAlreadyExists = 58;
inline constexpr int DiskFull = 61;
inline constexpr int InputPastEndOfFile = 62;
inline constexpr int PermissionDenied = 70;
inline constexpr int PathFileAccessError = 75;
inline constexpr int PathNotFound = 76;
} // namespace ErrorNumber

QmError InvalidCallError();

// Any failure as the error reports show it: a QmError as it is, running out of memory as 7, and
// anything else as 51, an internal error.
QmError ErrorOf(const std::exception& failure);
QmError InputPastEndOfFileError();
QmError OutOfMemoryError();
// 75: what the program cannot work on, such as a folder or a device where a file should be.
QmError PathFileAccessError(std::string detail = {});
// 75 for path, which is a folder, a device or anything else that is no regular file.
QmError NoRegularFileError(const std::string& path, bool folder);

// Maps an OS error (errno) met while working on path to the classic number and description.
QmError OsError(int errnoValue, const std::string& path);

// The system's reason for an OS error in words, as a message says it after a path: "permission
// denied", "read-only file system", "no space left on device".
std::string ReasonInWords(int errnoValue);
