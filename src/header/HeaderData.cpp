#include "HeaderData.h"

void ResetHeaderRecord(HeaderData& header)
{
    HeaderData empty;
    empty.FileChanged = header.FileChanged;
    empty.FileLoaded = header.FileLoaded;
    empty.Loading = header.Loading;
    header = std::move(empty);
}
