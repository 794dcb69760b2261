// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <functional>
#include <string>
#include <string_view>

#include "FileStamp.h"

class OpenPart;

// Looks at the first bytes of a file before the rest is read, and throws to refuse it.
using HeadCheck = std::function<void(std::string_view head)>;

// How many bytes a HeadCheck sees: all of a shorter file.
inline constexpr std::size_t HeadSize = std::size_t{64} * 1024;

// The bytes of a regular file, read at once into one buffer. Anything else (a folder, a FIFO, a
// device) is refused before a byte is read, so a file name can never make the program wait
// or read without end. A file that another program shortens or lengthens meanwhile yields the
// bytes that were there to read.
//
// The buffer is a string with room behind the bytes for turning every line end into CR LF, so
// that the parser can convert and compact it where it lies and keep it as the body: a file is
// held in memory once.
class FileBytes {
public:
    // Reads the open file from its start. The head check sees its first bytes before the rest is
    // read, so that a file it refuses costs no more than those. Throws QmError: the classic number
    // when the file cannot be read, 7 (Out of memory) when it is too large to work on.
    explicit FileBytes(const OpenPart& part, const HeadCheck& headCheck = {});
    // The same for any open file; path names it in messages.
    FileBytes(int fd, const std::string& path, const HeadCheck& headCheck = {});
    // The file at path, links followed; 75 (Path/File access error) when it is no regular file.
    explicit FileBytes(const std::string& path);

    std::string_view view() const { return bytes_; }
    // Hands the bytes over; the object holds none afterwards.
    std::string takeBytes() { return std::move(bytes_); }
    // The file as it was when it was opened.
    const FileStamp& stamp() const { return stamp_; }

private:
    std::string bytes_;
    FileStamp stamp_;
};
