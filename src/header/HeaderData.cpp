// SPDX-License-Identifier: MIT
#include "HeaderData.h"

void ResetHeaderRecord(HeaderData& header)
{
    HeaderData empty;
    empty.FileFolder = header.FileFolder; // the Open dialog still starts there
    empty.FileChanged = header.FileChanged;
    empty.FileLoaded = header.FileLoaded;
    empty.Loading = header.Loading;
    header = std::move(empty);
}
