// SPDX-License-Identifier: MIT
// libFuzzer target: any bytes are a part file. Reading, parsing and composing must never crash,
// and composing the parsed record must never throw.
#include <cstddef>
#include <cstdint>
#include <string>

#include "Composer.h"
#include "DescriptionTabs.h"
#include "Dialogs.h"
#include "ParseProgress.h"
#include "Parser.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    HeaderData header;
    DefaultAnswers dialogs;
    ParseProgress progress;
    ParsePartFileContent(header, std::string(reinterpret_cast<const char*>(data), size), dialogs, progress);
    header.AuthorRealName = header.ParsedRealName;
    RemoveDescriptionTabs(header, dialogs);
    const auto text = ComposeHeader(header);
    if (text.size() < 4)
        __builtin_trap();
    return 0;
}
