// SPDX-License-Identifier: MIT
#include "Corpus.h"

#include <algorithm>

#include "Text.h"

std::vector<std::filesystem::path> CorpusPartFiles()
{
    std::vector<std::filesystem::path> files;
    const std::filesystem::path root = QUILLMARK_CORPUS_DIR;
    std::error_code error;
    if (!std::filesystem::is_directory(root, error))
        return files;
    for (const auto& entry : std::filesystem::recursive_directory_iterator(root, error))
        if (entry.is_regular_file() && ToLowerAscii(entry.path().extension().string()) == ".dat")
            files.push_back(entry.path());
    std::sort(files.begin(), files.end());
    return files;
}
