// SPDX-License-Identifier: MIT
// libFuzzer target: any bytes are a part file. Reading, parsing and composing must never crash,
// and composing the parsed record must never throw. Bytes that are no text (a NUL among the first
// ones) are refused before they are parsed, as the program refuses such a file.
#include <cstddef>
#include <cstdint>
#include <string>

#include "Composer.h"
#include "DescriptionTabs.h"
#include "Dialogs.h"
#include "ParseProgress.h"
#include "Parser.h"
#include "TextFile.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    HeaderData header;
    DefaultAnswers dialogs;
    ParseProgress progress;
    try {
        ParsePartFileContent(header, std::string(reinterpret_cast<const char*>(data), size), dialogs, progress);
    } catch (const NotTextFileError&) {
        return 0;
    }
    header.AuthorRealName = header.ParsedRealName;
    RemoveDescriptionTabs(header, dialogs);
    const auto text = ComposeHeader(header);
    if (text.size() < 4)
        __builtin_trap();
    return 0;
}
