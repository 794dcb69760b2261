// SPDX-License-Identifier: MIT
#pragma once

#include <functional>
#include <string>
#include <string_view>

#include "HeaderData.h"

class Dialogs;
class ParseProgress;

// Distributes the lines of a CR LF text over the record: header fields and lists, OldHeader and
// Body. Replaces the lists and OldHeader and Body first, so a parse never adds to an earlier one.
// The text's string becomes the Body: handed over (moved in), the text costs no second copy.
void ParseHeaderText(HeaderData& header, std::string text, ParseProgress& progress);

// The content of the part file as read: the text check (NotTextFileError for a binary file), the
// line-end check (an empty file is reported as the check always has), the conversion of an
// LF-only file in memory, then the parse. The file on disk is never touched. Content with spare
// capacity is converted where it lies. False when the file was empty.
bool ParsePartFileContent(HeaderData& header, std::string content, Dialogs& dialogs, ParseProgress& progress);

// What is done with a part file once it is open and before it is read.
using PartCheck = std::function<void(const OpenPart&)>;

// Opens the file named by FilePath (see OpenPart::openPath), lets beforeRead look at it, then reads
// and parses it into header, a record of its own, which holds it open as Part. Failures (no such
// file, no regular file, an empty or binary file, a failed parse) are reported through dialogs
// and give false: the caller then drops the record.
bool GetGlobalContent(HeaderData& header, Dialogs& dialogs, ParseProgress& progress, const PartCheck& beforeRead = {});
