// SPDX-License-Identifier: MIT
#pragma once

#include <map>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "TextPositions.h"

// A text the client holds open, as the client has it (not as the file on disk has it).
struct Document {
    std::string uri;
    std::string path; // the file the uri names; empty for a uri that names no local file
    std::string text; // the bytes a save of it would write (UTF-8)
    long long version = 0;

    // The lines of the text, built when first asked for after a change.
    const LineIndex& lines() const;

private:
    friend class Documents;
    mutable std::unique_ptr<LineIndex> lines_;
};

// One change the client made: the range replaced, or none for the whole text.
struct TextChange {
    std::optional<std::pair<TextPosition, TextPosition>> range;
    std::string text;
};

// The local path a file: uri names, its %XX escapes decoded; nullopt for any other uri.
std::optional<std::string> PathOfUri(std::string_view uri);

// The documents open in the client, by uri.
class Documents {
public:
    Document& open(const std::string& uri, std::string text, long long version);
    // Applies the changes in their order (each range is of the text the change before left).
    // False when the document is not open.
    bool change(const std::string& uri, long long version, const std::vector<TextChange>& changes,
                PositionEncoding encoding);
    void close(const std::string& uri) { documents_.erase(uri); }
    Document* find(const std::string& uri);

private:
    std::map<std::string, Document> documents_;
};
