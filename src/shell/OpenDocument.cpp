// SPDX-License-Identifier: MIT
#include "OpenDocument.h"

#include "DescriptionTabs.h"
#include "ParseProgress.h"
#include "Parser.h"
#include "Paths.h"

void TakeFileToOpen(HeaderData& header, const std::string& path, Dialogs& dialogs)
{
    header.FilePath = path;
    header.PartName = DateiNurName(path, dialogs);
    header.FileFolder = DateiNurPfad(path);
    header.FileLoaded = true;
    header.FileChanged = false;
}

bool FinishOpenedRecord(HeaderData& header, Dialogs& dialogs)
{
    header.AuthorRealName = header.ParsedRealName;
    return RemoveDescriptionTabs(header, dialogs);
}

void OpenPartFileContent(HeaderData& header, const std::string& path, std::string content, Dialogs& dialogs,
                         ParseProgress& progress)
{
    header.Loading = true;
    ResetHeaderRecord(header);
    TakeFileToOpen(header, path, dialogs);
    ParsePartFileContent(header, std::move(content), dialogs, progress);
    FinishOpenedRecord(header, dialogs);
    header.Loading = false;
}
