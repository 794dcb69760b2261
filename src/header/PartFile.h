#pragma once

#include <string>
#include <string_view>

// The bytes of a file, read at once. A regular file is mapped into memory (no copy, which
// matters for part files of many megabytes); anything else is read.
class FileBytes {
public:
    // Throws QmError with the classic number when the file cannot be read.
    explicit FileBytes(const std::string& path);
    ~FileBytes();
    FileBytes(const FileBytes&) = delete;
    FileBytes& operator=(const FileBytes&) = delete;

    std::string_view view() const { return mapped_ ? std::string_view(mapped_, mappedSize_) : std::string_view(read_); }

private:
    const char* mapped_ = nullptr;
    std::size_t mappedSize_ = 0;
    std::string read_;
};
