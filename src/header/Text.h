// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

#include "HeaderData.h"

// Text is bytes: "blank" is the space character alone, and case changes touch ASCII letters only.

inline constexpr std::string_view CrLf = "\r\n";
inline constexpr std::string_view Utf8ByteOrderMark = "\xEF\xBB\xBF";

// What a save writes before the composed header: the byte order mark the file began with, if any.
inline std::string_view TextBeforeHeader(const HeaderData& header)
{
    return header.ByteOrderMark ? Utf8ByteOrderMark : std::string_view();
}

std::string_view TrimBlanks(std::string_view text);
// The text without the blanks at its end.
std::string_view TrimTrailingBlanks(std::string_view text);

std::string ToLowerAscii(std::string_view text);
std::string ToUpperAscii(std::string_view text);

// True when needle occurs in text, comparing ASCII letters without regard to case.
bool ContainsIgnoreCase(std::string_view text, std::string_view needle);
// True when text begins with prefix, comparing ASCII letters without regard to case.
bool StartsWithIgnoreCase(std::string_view text, std::string_view prefix);

bool IsValidUtf8(std::string_view bytes);
// Checks bytes as UTF-8 from position from (the start of a character) up to at least until: the
// position where the check stopped, a character boundary at or after until (or the end), or npos
// when a byte is not UTF-8. Checked piece by piece, a text gives what one check of it gives.
std::size_t CheckUtf8(std::string_view bytes, std::size_t from, std::size_t until);
TextEncoding EncodingOf(std::string_view bytes);

// The number of characters the window shows for text: code points in UTF-8, else bytes.
std::size_t CharacterCount(std::string_view text, TextEncoding encoding);

// Each byte as the ISO-8859-1 character of that code, encoded as UTF-8.
std::string Latin1ToUtf8(std::string_view bytes);
// Valid UTF-8 text as a file of that encoding writes it: as it is in UTF-8, each character as its
// byte in ISO-8859-1; nullopt when a character has no byte there.
std::optional<std::string> Utf8ToFileText(std::string_view utf8, TextEncoding encoding);
