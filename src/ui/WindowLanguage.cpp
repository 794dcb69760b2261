// SPDX-License-Identifier: MIT
#include "WindowLanguage.h"

#include <QCoreApplication>
#include <QLibraryInfo>
#include <QTranslator>
#include <memory>

#include "ListFolder.h"

QLocale WindowLocale(const QLocale& system)
{
    const auto chosen = qEnvironmentVariable("QUILLMARK_LANGUAGE");
    return chosen.isEmpty() ? system : QLocale(chosen);
}

namespace {

bool install(const QLocale& locale, const QString& name, const QStringList& folders)
{
    auto translator = std::make_unique<QTranslator>(QCoreApplication::instance());
    for (const auto& folder : folders)
        if (translator->load(locale, name, "_", folder)) {
            QCoreApplication::installTranslator(translator.release());
            return true;
        }
    return false;
}

} // namespace

bool InstallWindowTranslation(const QLocale& locale, const std::string& programFolder)
{
    if (locale.language() == QLocale::English || locale.language() == QLocale::C)
        return false;
    const auto folder = QString::fromStdString(programFolder);
    const auto installed = QString::fromStdString(DataFileOfThisProgram(programFolder, "translations"));
    install(locale, "qtbase", {QLibraryInfo::path(QLibraryInfo::TranslationsPath)});
    return install(locale, "quillmark", {folder + "/translations", installed});
}
