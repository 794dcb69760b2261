// SPDX-License-Identifier: MIT
#pragma once

#include <filesystem>
#include <set>
#include <string>
#include <sys/stat.h>

// A fresh folder under the system's temporary folder, removed with everything in it.
class TempDir {
public:
    TempDir();
    ~TempDir();
    TempDir(const TempDir&) = delete;
    TempDir& operator=(const TempDir&) = delete;

    const std::filesystem::path& path() const { return path_; }
    std::string file(const std::string& name) const { return (path_ / name).string(); }
    // Writes bytes to name in the folder and returns its full path.
    std::string write(const std::string& name, const std::string& bytes) const;
    static void writeTo(const std::string& path, const std::string& bytes);

private:
    std::filesystem::path path_;
};

std::string ReadBytes(const std::string& path);

// What lstat says of path (zeros when it fails).
struct stat StatOf(const std::string& path);

// The names of the entries in folder.
std::set<std::string> NamesIn(const std::filesystem::path& folder);
