#include "ListFolder.h"

#include <QDir>
#include <QStandardPaths>
#include <filesystem>

#include "ListKinds.h"

namespace fs = std::filesystem;

namespace {

bool allListsIn(const std::string& folder)
{
    for (const auto kind : AllListKinds) {
        std::error_code error;
        if (!fs::is_regular_file(fs::path(folder) / InfoOf(kind).fileName, error))
            return false;
    }
    return true;
}

} // namespace

std::string ListFolderFor(const std::string& programFolder, const std::string& userFolder,
                          const std::string& defaultsFolder)
{
    if (allListsIn(programFolder))
        return programFolder;
    std::error_code error;
    fs::create_directories(userFolder, error);
    for (const auto kind : AllListKinds) {
        const auto name = InfoOf(kind).fileName;
        const auto copy = fs::path(userFolder) / name;
        if (!fs::exists(copy, error)) {
            fs::copy_file(fs::path(defaultsFolder) / name, copy, error);
            fs::permissions(copy, fs::perms::owner_read | fs::perms::owner_write, fs::perm_options::add, error);
        }
    }
    return userFolder;
}

std::string ListFolderOfThisProgram(const std::string& programFolder)
{
    const auto userFolder = QStandardPaths::writableLocation(QStandardPaths::GenericDataLocation) + "/Quillmark";
    const auto defaults = QDir(QString::fromStdString(programFolder)).filePath(QUILLMARK_DEFAULTS_FROM_PROGRAM);
    return ListFolderFor(programFolder, userFolder.toStdString(), QDir::cleanPath(defaults).toStdString());
}

std::string FirstOpenFolder(const std::string& programFolder, const std::string& listFolder)
{
    return listFolder == programFolder ? programFolder : QDir::homePath().toStdString();
}

std::string DataFileOfThisProgram(const std::string& programFolder, const std::string& name)
{
    std::error_code error;
    const auto beside = fs::path(programFolder) / name;
    if (fs::is_regular_file(beside, error))
        return beside.string();
    const auto defaults = QDir(QString::fromStdString(programFolder)).filePath(QUILLMARK_DEFAULTS_FROM_PROGRAM);
    return (fs::path(QDir::cleanPath(defaults).toStdString()) / name).string();
}
