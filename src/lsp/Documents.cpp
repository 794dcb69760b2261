// SPDX-License-Identifier: MIT
#include "Documents.h"

#include <algorithm>

namespace {

int hexValue(char c)
{
    if (c >= '0' && c <= '9')
        return c - '0';
    c = static_cast<char>(c | 0x20);
    return c >= 'a' && c <= 'f' ? c - 'a' + 10 : -1;
}

} // namespace

const LineIndex& Document::lines() const
{
    if (!lines_)
        lines_ = std::make_unique<LineIndex>(text);
    return *lines_;
}

std::optional<std::string> PathOfUri(std::string_view uri)
{
    constexpr std::string_view scheme = "file://";
    if (!uri.starts_with(scheme))
        return std::nullopt;
    uri.remove_prefix(scheme.size());
    if (!uri.starts_with('/')) // file://host/path: only this machine's files are read
        return std::nullopt;
    std::string path;
    for (std::size_t k = 0; k < uri.size(); ++k) {
        if (uri[k] == '%' && k + 2 < uri.size() && hexValue(uri[k + 1]) >= 0 && hexValue(uri[k + 2]) >= 0) {
            path += static_cast<char>(hexValue(uri[k + 1]) * 16 + hexValue(uri[k + 2]));
            k += 2;
        } else
            path += uri[k];
    }
    return path;
}

Document& Documents::open(const std::string& uri, std::string text, long long version)
{
    auto& document = documents_[uri];
    document.uri = uri;
    document.path = PathOfUri(uri).value_or("");
    document.text = std::move(text);
    document.version = version;
    document.lines_.reset();
    return document;
}

bool Documents::change(const std::string& uri, long long version, const std::vector<TextChange>& changes,
                       PositionEncoding encoding)
{
    auto* document = find(uri);
    if (document == nullptr)
        return false;
    for (const auto& change : changes) {
        if (!change.range) {
            document->text = change.text;
        } else {
            const auto& lines = document->lines();
            const auto from = lines.offsetOf(document->text, change.range->first, encoding);
            const auto to = std::max(from, lines.offsetOf(document->text, change.range->second, encoding));
            document->text.replace(from, to - from, change.text);
        }
        document->lines_.reset();
    }
    document->version = version;
    return true;
}

Document* Documents::find(const std::string& uri)
{
    const auto found = documents_.find(uri);
    return found == documents_.end() ? nullptr : &found->second;
}
