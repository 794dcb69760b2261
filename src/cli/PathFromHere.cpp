// SPDX-License-Identifier: MIT
#include "PathFromHere.h"

#include <filesystem>

namespace fs = std::filesystem;

PathFromHere SavedPathFromHere(const std::string& path)
{
    std::error_code error;
    return SavedPathFrom(path, fs::current_path(error).string());
}

PathFromHere SavedPathFrom(const std::string& path, const std::string& folder)
{
    std::error_code error;
    const fs::path here = folder;
    auto saved = fs::weakly_canonical(fs::absolute(path, error), error);
    if (error)
        saved = fs::absolute(path, error).lexically_normal();
    const auto relative = saved.lexically_relative(fs::weakly_canonical(here, error));
    if (!relative.empty() && *relative.begin() != ".." && relative != ".")
        return {relative.string(), true};
    return {saved.string(), false};
}
