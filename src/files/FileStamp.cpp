// SPDX-License-Identifier: MIT
#include "FileStamp.h"

#include <sys/stat.h>

FileStamp StampOf(const struct stat& info)
{
    return {true,
            static_cast<std::uint64_t>(info.st_dev),
            static_cast<std::uint64_t>(info.st_ino),
            static_cast<std::int64_t>(info.st_size),
            static_cast<std::int64_t>(info.st_mtim.tv_sec),
            static_cast<std::int64_t>(info.st_mtim.tv_nsec)};
}
