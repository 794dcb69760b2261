// SPDX-License-Identifier: MIT
#pragma once

#include <chrono>
#include <cstddef>
#include <functional>
#include <mutex>
#include <string>
#include <string_view>
#include <utility>

#include "FileStamp.h"

class OpenPart;

// Opening a file holds its bytes (which become the body), the header taken out of them and the
// composed text: up to about three times its size. The largest file that fits three times into
// memory (or the process's address-space limit); a larger one is refused up front rather than
// failing half-way.
std::size_t RoomForFiles();

// The files that the threads of a run hold at once, so that together they stay within
// RoomForFiles: a file that does not fit beside the others is refused.
class MemoryClaims {
public:
    // Gives its bytes back when it goes.
    class Claim {
    public:
        ~Claim();
        Claim(Claim&& other) noexcept : claims_(std::exchange(other.claims_, nullptr)), size_(other.size_) {}
        Claim(const Claim&) = delete;
        Claim& operator=(const Claim&) = delete;
        Claim& operator=(Claim&&) = delete;

    private:
        friend class MemoryClaims;
        Claim(MemoryClaims* claims, std::size_t size) : claims_(claims), size_(size) {}
        MemoryClaims* claims_;
        std::size_t size_;
    };
    // Throws QmError 7 (Out of memory) when size does not fit beside what is claimed.
    Claim claim(std::size_t size);
    // RoomForFiles, asked of the system at most once a second.
    std::size_t room();

private:
    std::size_t roomLocked();

    std::mutex mutex_;
    std::size_t claimed_ = 0;
    std::size_t room_ = 0;
    std::chrono::steady_clock::time_point asked_;
};

// Reads up to size bytes of the open file fd at offset, fewer only at the end of the file. The
// file's own offset is left alone: the descriptor may be shared with whoever holds the file open.
// A failure throws QmError naming path.
std::size_t ReadAt(int fd, char* buffer, std::size_t size, std::size_t offset, const std::string& path);
// One read of up to size bytes at offset: fewer at the end of the file, or when a signal cut it short.
std::size_t ReadSome(int fd, char* buffer, std::size_t size, std::size_t offset, const std::string& path);

// Looks at a file's bytes as they are read, and throws to refuse the file: first at its head
// (HeadSize bytes, all of a shorter file) before the rest is read, then at each further piece
// as it arrives, so that a refused file costs no more than the bytes up to the reason.
using ReadCheck = std::function<void(std::string_view bytes)>;

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
    // Reads the open file from its start, each piece shown to check (see ReadCheck). Throws
    // QmError: the classic number when the file cannot be read, 7 (Out of memory) when it is too
    // large to work on.
    // memory: the run's, whose figures stand for the system's.
    explicit FileBytes(const OpenPart& part, const ReadCheck& check = {}, MemoryClaims* memory = nullptr);
    // The same for any open file; path names it in messages.
    FileBytes(int fd, const std::string& path, const ReadCheck& check = {}, MemoryClaims* memory = nullptr);
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
