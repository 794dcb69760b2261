// SPDX-License-Identifier: MIT
#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "Clock.h"
#include "HeaderData.h"

// The same changes to the headers of many files: each field that is set changes the record, in
// the order the fields stand here. The composer then writes the header as for any edit.
struct HeaderEdits {
    std::optional<std::string> description;
    std::optional<std::string> author; // "Real Name [user]"; either part alone changes that part only
    std::optional<std::string> type;
    std::optional<std::string> update;
    std::optional<std::string> license; // an entry of the licence list, or CurrentLicense
    std::optional<std::string> bfc;
    std::optional<std::string> category; // empty: no category line
    StringList addKeywords, removeKeywords;
    std::optional<std::string> addHistory; // the text after "YYYY-MM-DD [user] "
    std::string historyUser;
    bool nameFromPath = false;
};

// The licence word that picks the licence the library wants for the file.
inline constexpr std::string_view CurrentLicense = "current";
inline constexpr std::string_view CcBy4License = "Licensed under CC BY 4.0 : see CAreadme.txt";
inline constexpr std::string_view CcBy2And4License = "Licensed under CC BY 2.0 and CC BY 4.0 : see CAreadme.txt";
inline constexpr std::string_view Cc0License = "Marked with CC0 1.0 : see CAreadme.txt";

// The keywords of a "a, b" text: split at commas, blanks around each removed, empty ones dropped.
StringList SplitKeywords(std::string_view text);

// The folder a part type's files carry in their "Name:", with its "\": "s\" for a subpart, "8\"
// and "48\" for those primitives, "helpers\" for a helper, none for the others. "Unofficial_"
// before the type and words after it do not count.
std::string NameFolderOfType(std::string_view partType);

// Turns the edits' values, valid UTF-8, into the text of a file of that encoding (see
// Utf8ToFileText). Returns the first value that the encoding cannot hold, the edits then left
// partly turned; nothing when all could be.
std::optional<std::string> EncodeHeaderEdits(HeaderEdits& edits, TextEncoding encoding);

// Applies the edits to the record; today dates an added history line. Returns why the file is
// left as it is (a BFC winding that the edit would turn round), or nothing when it was edited.
std::optional<std::string> ApplyHeaderEdits(HeaderData& header, const HeaderEdits& edits, const LocalDateTime& today);
