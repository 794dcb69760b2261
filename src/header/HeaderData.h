// SPDX-License-Identifier: MIT
#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "EntryList.h"
#include "FileLines.h"
#include "FileStamp.h"
#include "OpenPart.h"

// A list of texts, such as a list file's entries. The texts talk about entry 1 to count; the code
// indexes from 0.
using StringList = std::vector<std::string>;

// How the window shows the file's bytes: a file whose bytes are valid UTF-8 is edited as
// UTF-8, any other as ISO-8859-1. The core itself only ever handles bytes.
enum class TextEncoding { Latin1, Utf8 };

// The one record of the open part file, with its document flags.
struct HeaderData {
    std::string FilePath;
    std::string PartName;
    std::string FileFolder;
    std::string PartDescription;
    bool NeedsWork = false;
    std::string ParsedRealName;
    std::string AuthorRealName;
    std::string AuthorUserName;
    std::string PartType;
    std::string UpdateTag;
    std::string License;
    std::string Bfc;
    std::string Category;
    EntryList Keywords;
    EntryList History;
    EntryList Comments;
    EntryList HelpLines;
    EntryList CmdLines;
    EntryList ColorLines;
    std::string OldHeader;
    std::string Body;
    // Where the lines of OldHeader and of Body stand in the file as it was read.
    FileLines OldHeaderLines, BodyLines;
    TextEncoding Encoding = TextEncoding::Utf8;
    // The file began with a UTF-8 byte order mark: not part of the header, and written back.
    bool ByteOrderMark = false;
    // The file at FilePath, held open from the read to the save, so that the save writes the file
    // that was read and no other; null when nothing was read.
    std::shared_ptr<OpenPart> Part;
    // Part as it was read, or as the last save left it; none when nothing was read.
    std::optional<FileStamp> ReadStamp;
    // The composed header as the open or the last save left it: the file counts as changed only
    // while the header composed now differs from it.
    std::string HeaderAtOpenOrSave;

    // The body was changed since the open or the last save (by the Parts Tracker's repairs).
    bool BodyChanged = false;

    bool FileChanged = false;
    bool FileLoaded = false;
    bool Loading = false;
};

// Empties the record at the start of an open; the document flags and FileFolder stay.
void ResetHeaderRecord(HeaderData& header);
