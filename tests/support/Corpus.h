// SPDX-License-Identifier: MIT
#pragma once

#include <filesystem>
#include <vector>

// The real part files of the shared corpus (../shared/corpus beside the project), read in
// place. Empty when the folder is absent, so the tests that need it skip.
std::vector<std::filesystem::path> CorpusPartFiles();
