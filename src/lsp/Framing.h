// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <mutex>
#include <string>
#include <string_view>

// The base protocol of the Language Server Protocol: each message is a header of "Name: value"
// lines ending in CR LF, a blank line, and then Content-Length bytes of JSON.

// Reads messages from a descriptor, one at a time.
class MessageReader {
public:
    // A body longer than this is refused and skipped: it would not fit beside the documents.
    static constexpr std::size_t MaxBody = std::size_t{1} << 30;

    // stop: a descriptor that becomes readable when reading should end; -1 for none.
    explicit MessageReader(int fd, int stop = -1) : fd_(fd), stop_(stop) {}

    enum class Status {
        Message, // body holds the message's content
        Broken,  // the header was not one of the base protocol: problem says why; reading goes on after it
        End      // the input ended (or failed)
    };
    struct Read {
        Status status;
        std::string body;
        std::string problem;
    };
    Read next();

private:
    bool fill(); // false at the end of the input
    bool skipBody(std::size_t length);

    int fd_, stop_;
    std::string buffer_;
    std::size_t start_ = 0; // of the unread bytes in buffer_
};

// Writes messages to a descriptor; safe to use from several threads. A client that went away is
// not an error of the sender: later messages are dropped.
class MessageWriter {
public:
    explicit MessageWriter(int fd) : fd_(fd) {}
    void send(std::string_view body);

private:
    int fd_;
    std::mutex mutex_;
    bool gone_ = false;
};
