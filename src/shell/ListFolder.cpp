// SPDX-License-Identifier: MIT
#include "ListFolder.h"

#include <QCryptographicHash>
#include <QDir>
#include <QFile>
#include <QStandardPaths>
#include <filesystem>
#include <fstream>
#include <map>
#include <optional>

#include "ListKinds.h"
#include "QmError.h"
#include "SafeReplace.h"

namespace fs = std::filesystem;

namespace {

// What was last copied from the defaults into the user's folder, one "digest  name" line per
// list as sha256sum writes them: a copy whose bytes still have that digest is unedited.
constexpr const char* CopiedDefaultsName = "copied-defaults.sha256";
using Digests = std::map<std::string, std::string>;

bool allListsIn(const std::string& folder)
{
    for (const auto kind : AllListKinds) {
        std::error_code error;
        if (!fs::is_regular_file(fs::path(folder) / InfoOf(kind).fileName, error))
            return false;
    }
    return true;
}

std::optional<QByteArray> bytesOf(const fs::path& path)
{
    QFile file(QString::fromStdString(path.string()));
    if (!file.open(QIODevice::ReadOnly))
        return std::nullopt;
    return file.readAll();
}

std::string digestOf(const QByteArray& bytes)
{
    return QCryptographicHash::hash(bytes, QCryptographicHash::Sha256).toHex().toStdString();
}

Digests readDigests(const fs::path& file)
{
    Digests digests;
    std::ifstream in(file);
    std::string digest, name;
    while (in >> digest >> name)
        digests[name] = digest;
    return digests;
}

// Writes the file the way the list editor writes lists; a failure only costs a later refresh.
bool replaceQuietly(const fs::path& path, std::string_view bytes)
{
    try {
        ReplaceFileSafely(path.string(), {bytes});
        return true;
    } catch (const QmError&) {
        return false;
    }
}

void writeDigests(const fs::path& file, const Digests& digests)
{
    std::string text;
    for (const auto& [name, digest] : digests)
        text += digest + "  " + name + "\n";
    replaceQuietly(file, text);
}

// A missing copy is made; an unedited copy follows a changed default; an edited one stays.
// Copies are new files of this user, with this user's default mode, whatever mode the
// installed defaults have.
void copyDefaults(const fs::path& userFolder, const fs::path& defaultsFolder)
{
    const auto digestsFile = userFolder / CopiedDefaultsName;
    auto copied = readDigests(digestsFile);
    bool changed = false;
    for (const auto kind : AllListKinds) {
        const std::string name = InfoOf(kind).fileName;
        const auto installed = bytesOf(defaultsFolder / name);
        if (!installed)
            continue;
        const auto copy = userFolder / name;
        std::error_code error;
        const bool missing = !fs::exists(copy, error) && !error;
        const auto current = missing ? std::nullopt : bytesOf(copy);
        const bool unedited = current && copied.count(name) != 0 && digestOf(*current) == copied[name];
        const auto installedDigest = digestOf(*installed);
        if ((missing || (unedited && installedDigest != copied[name])) &&
            replaceQuietly(copy, std::string_view(installed->constData(), installed->size()))) {
            copied[name] = installedDigest;
            changed = true;
        }
    }
    if (changed)
        writeDigests(digestsFile, copied);
}

} // namespace

std::string ListFolderFor(const std::string& programFolder, const std::string& userFolder,
                          const std::string& defaultsFolder)
{
    if (allListsIn(programFolder))
        return programFolder;
    std::error_code error;
    fs::create_directories(userFolder, error);
    copyDefaults(userFolder, defaultsFolder);
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
