// SPDX-License-Identifier: MIT
#include "Framing.h"

#include <cerrno>
#include <charconv>
#include <optional>
#include <poll.h>
#include <unistd.h>

#include "Text.h"

namespace {

constexpr std::size_t ChunkSize = 64 * 1024;

// The value of the Content-Length field of a header block; nullopt when it has none or a broken one.
std::optional<std::size_t> contentLength(std::string_view header, std::string& problem)
{
    std::optional<std::size_t> length;
    while (!header.empty()) {
        const auto end = header.find("\r\n");
        auto line = header.substr(0, end);
        header = end == std::string_view::npos ? std::string_view() : header.substr(end + 2);
        const auto colon = line.find(':');
        if (colon == std::string_view::npos) {
            problem = "a header line without a colon";
            return std::nullopt;
        }
        if (colon != 14 || !StartsWithIgnoreCase(line, "Content-Length"))
            continue; // Content-Type, or a field of a later protocol
        auto value = line.substr(colon + 1);
        while (!value.empty() && value.front() == ' ')
            value.remove_prefix(1);
        std::size_t number = 0;
        const auto [rest, error] = std::from_chars(value.data(), value.data() + value.size(), number);
        if (error != std::errc() || rest != value.data() + value.size() || value.empty()) {
            problem = "a Content-Length that is not a number";
            return std::nullopt;
        }
        length = number;
    }
    if (!length)
        problem = "a header without Content-Length";
    return length;
}

} // namespace

bool MessageReader::fill()
{
    if (start_ > 0 && start_ >= buffer_.size() / 2) {
        buffer_.erase(0, start_);
        start_ = 0;
    }
    const auto had = buffer_.size();
    buffer_.resize(had + ChunkSize);
    if (stop_ >= 0) {
        pollfd waits[2] = {{fd_, POLLIN, 0}, {stop_, POLLIN, 0}};
        int ready = 0;
        while ((ready = ::poll(waits, 2, -1)) < 0 && errno == EINTR) {
        }
        if (ready < 0 || waits[1].revents != 0) {
            buffer_.resize(had);
            return false;
        }
    }
    ssize_t got = 0;
    do
        got = ::read(fd_, buffer_.data() + had, ChunkSize);
    while (got < 0 && errno == EINTR);
    buffer_.resize(had + static_cast<std::size_t>(std::max<ssize_t>(got, 0)));
    return got > 0;
}

bool MessageReader::skipBody(std::size_t length)
{
    while (buffer_.size() - start_ < length) {
        length -= buffer_.size() - start_;
        buffer_.clear();
        start_ = 0;
        if (!fill())
            return false;
    }
    start_ += length;
    return true;
}

MessageReader::Read MessageReader::next()
{
    std::size_t headerEnd;
    while ((headerEnd = std::string_view(buffer_).find("\r\n\r\n", start_)) == std::string_view::npos)
        if (!fill())
            return {Status::End, {}, {}};
    const auto header = std::string_view(buffer_).substr(start_, headerEnd - start_);
    start_ = headerEnd + 4;
    Read read{Status::Broken, {}, {}};
    const auto length = contentLength(header, read.problem);
    if (!length)
        return read;
    if (*length > MaxBody) {
        read.problem = "a message larger than " + std::to_string(MaxBody) + " bytes";
        return skipBody(*length) ? read : Read{Status::End, {}, {}};
    }
    while (buffer_.size() - start_ < *length)
        if (!fill())
            return {Status::End, {}, {}};
    read.status = Status::Message;
    read.body.assign(buffer_, start_, *length);
    start_ += *length;
    return read;
}

void MessageWriter::send(std::string_view body)
{
    const auto framed = "Content-Length: " + std::to_string(body.size()) + "\r\n\r\n" + std::string(body);
    const std::lock_guard lock(mutex_);
    std::size_t done = 0;
    while (!gone_ && done < framed.size()) {
        const auto wrote = ::write(fd_, framed.data() + done, framed.size() - done);
        if (wrote < 0 && errno == EINTR)
            continue;
        if (wrote <= 0)
            gone_ = true;
        else
            done += static_cast<std::size_t>(wrote);
    }
}
