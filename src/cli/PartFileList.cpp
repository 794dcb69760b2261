#include "PartFileList.h"

#include <algorithm>
#include <filesystem>

#include "Text.h"

namespace fs = std::filesystem;

namespace {

bool isPartFileName(const fs::path& path) { return ToLowerAscii(path.extension().string()) == ".dat"; }

std::vector<std::string> partFilesBelow(const fs::path& folder)
{
    std::vector<std::string> files;
    std::error_code error;
    // An unreadable subfolder is passed over rather than ending the walk.
    for (fs::recursive_directory_iterator walk(folder, fs::directory_options::skip_permission_denied, error), end;
         walk != end; walk.increment(error)) {
        if (error)
            break;
        if (walk->is_regular_file(error) && isPartFileName(walk->path()))
            files.push_back(walk->path().string());
    }
    std::sort(files.begin(), files.end());
    return files;
}

} // namespace

std::vector<std::string> ExpandPartFiles(const std::vector<std::string>& arguments)
{
    std::vector<std::string> files;
    for (const auto& argument : arguments) {
        std::error_code error;
        if (!fs::is_directory(argument, error)) {
            files.push_back(argument);
            continue;
        }
        const auto below = partFilesBelow(argument);
        files.insert(files.end(), below.begin(), below.end());
    }
    return files;
}
