// SPDX-License-Identifier: MIT
#include "Attributes.h"

#include <cerrno>
#include <map>
#include <optional>
#include <string>
#include <sys/xattr.h>

namespace {

using Attributes = std::map<std::string, std::string>;

// Calls fill(buffer, size) as the *xattr calls want: first for the size, then for the bytes.
template <typename Fill>
std::optional<std::string> readSized(const Fill& fill)
{
    for (int attempt = 0; attempt < 4; ++attempt) {
        const auto size = fill(nullptr, 0);
        if (size < 0)
            return std::nullopt;
        std::string bytes(static_cast<std::size_t>(size), '\0');
        const auto got = fill(bytes.data(), bytes.size());
        if (got >= 0) {
            bytes.resize(static_cast<std::size_t>(got));
            return bytes;
        }
        if (errno != ERANGE) // ERANGE: it grew meanwhile
            return std::nullopt;
    }
    return std::nullopt;
}

// Nullopt when they cannot be read; none at all where the file system has no attributes.
template <typename List, typename Get>
std::optional<Attributes> attributes(const List& list, const Get& get)
{
    const auto names = readSized(list);
    if (!names)
        return errno == ENOTSUP ? std::optional(Attributes{}) : std::nullopt;
    Attributes result;
    for (std::size_t start = 0; start < names->size();) {
        const std::string name(names->c_str() + start);
        start += name.size() + 1;
        auto value = readSized([&](char* buffer, std::size_t size) { return get(name, buffer, size); });
        if (!value)
            return std::nullopt;
        result.emplace(name, std::move(*value));
    }
    return result;
}

} // namespace

bool TakeAttributesOf(int from, int fd)
{
    const auto wanted = attributes(
        [&](char* b, std::size_t s) { return ::flistxattr(from, b, s); },
        [&](const std::string& name, char* b, std::size_t s) { return ::fgetxattr(from, name.c_str(), b, s); });
    const auto present = attributes(
        [&](char* b, std::size_t s) { return ::flistxattr(fd, b, s); },
        [&](const std::string& name, char* b, std::size_t s) { return ::fgetxattr(fd, name.c_str(), b, s); });
    if (!wanted || !present)
        return false;
    for (const auto& [name, value] : *present)
        if (!wanted->contains(name) && ::fremovexattr(fd, name.c_str()) != 0)
            return false;
    for (const auto& [name, value] : *wanted) {
        const auto same = present->find(name);
        if (same != present->end() && same->second == value)
            continue; // a label the system gave the new file already, which it may not let us set
        if (::fsetxattr(fd, name.c_str(), value.data(), value.size(), 0) != 0)
            return false;
    }
    return true;
}
