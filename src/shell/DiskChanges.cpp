// SPDX-License-Identifier: MIT
#include "DiskChanges.h"

#include <QCoreApplication>
#include <sys/stat.h>

#include "Dialogs.h"

std::string DiskMark(const std::string& path)
{
    struct stat info {};
    if (::stat(path.c_str(), &info) != 0)
        return {};
    return std::to_string(info.st_dev) + ":" + std::to_string(info.st_ino) + ":" + std::to_string(info.st_size) + ":" +
           std::to_string(info.st_ctim.tv_sec) + "." + std::to_string(info.st_ctim.tv_nsec);
}

bool ChangedOnDisk(const HeaderData& header)
{
    if (!header.Part || !header.ReadStamp || DiskMark(header.FilePath).empty())
        return false;
    return !header.Part->unchangedSince(*header.ReadStamp);
}

bool AskToReload(const HeaderData& header, Dialogs& dialogs)
{
    const auto tr = [](const char* text) { return QCoreApplication::translate("DiskChanges", text).toStdString(); };
    const auto text = header.FilePath + tr(" was changed by another program.\r\nReload it and lose your changes?") +
                      (header.FileChanged ? tr("\r\nNo keeps editing; a save then asks before it overwrites.")
                                          : tr("\r\nNo keeps editing."));
    return dialogs.message({text, tr("Changed by Another Program"), Buttons::YesNo, Icon::Question,
                            header.FileChanged ? Answer::No : Answer::Yes}) == Answer::Yes;
}
