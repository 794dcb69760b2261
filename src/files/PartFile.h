#pragma once

#include <memory>
#include <string>
#include <string_view>

#include "FileStamp.h"

// The bytes of a regular file, read at once into one buffer. Anything else (a folder, a FIFO, a
// device) is refused before a byte is read, so a file name can never make the program wait
// or read without end. A file that another program shortens or lengthens meanwhile yields the
// bytes that were there to read.
class FileBytes {
public:
    // Throws QmError: the classic number when the file cannot be read, 75 (Path/File access
    // error) when it is no regular file, 7 (Out of memory) when it is too large to work on.
    explicit FileBytes(const std::string& path);

    std::string_view view() const { return {bytes_.get(), size_}; }
    // The file as it was when it was opened.
    const FileStamp& stamp() const { return stamp_; }

private:
    std::unique_ptr<char[]> bytes_;
    std::size_t size_ = 0;
    FileStamp stamp_;
};
