// SPDX-License-Identifier: MIT
// Quillmark: the window program.
#include <QApplication>
#include <QIcon>
#include <cstring>
#include <iostream>
#include <optional>

#include "AppState.h"
#include "Clock.h"
#include "EventLoop.h"
#include "IniSettingsStore.h"
#include "ListFolder.h"
#include "QtDialogs.h"
#include "WindowFont.h"
#include "WindowLanguage.h"
#include "frmMain.h"

namespace {

// --help and --version answer without a display.
bool answeredOnTheCommandLine(int argc, char** argv)
{
    if (argc < 2)
        return false;
    if (std::strcmp(argv[1], "--version") == 0) {
        std::cout << "quillmark " << QUILLMARK_VERSION << '\n';
        return true;
    }
    if (std::strcmp(argv[1], "--help") == 0) {
        std::cout << "Usage: quillmark [FILE]\n"
                     "Edit the header of an LDraw part file (*.dat): the window opens FILE when it is given.\n\n"
                     "  --help     show this text and exit\n"
                     "  --version  show the version and exit\n"
                     "  --         the next argument is the file, even when it starts with \"-\"\n\n"
                     "quillmark-cli runs the same checks and saves from the command line.\n";
        return true;
    }
    return false;
}

// An option this program does not know, once Qt took its own (-platform, -style, ...): refused with
// exit status 2, before any window. "--" ends the options, so that a file may start with "-".
std::optional<QString> unknownOption(const QStringList& arguments)
{
    for (const auto& argument : arguments.mid(1)) {
        if (argument == "--")
            return std::nullopt;
        if (argument.size() > 1 && argument.startsWith('-'))
            return argument;
    }
    return std::nullopt;
}

// The file to open: the first argument that is not "--".
QStringList fileArguments(const QStringList& arguments)
{
    auto files = arguments.mid(1);
    files.removeOne("--");
    return files;
}

} // namespace

int main(int argc, char** argv)
{
    if (answeredOnTheCommandLine(argc, argv))
        return 0;
    UseLeanEventLoop();
    QApplication application(argc, argv); // takes Qt's own options (-platform, -style, ...) out of argv
    if (const auto option = unknownOption(application.arguments())) {
        std::cerr << "quillmark: unknown option " << option->toStdString() << "\nTry 'quillmark --help'.\n";
        return 2;
    }
    QApplication::setApplicationName("Quillmark");
    // Ties the windows to the desktop entry (Wayland's app id), so docks show its icon and can pin it.
    QGuiApplication::setDesktopFileName(QUILLMARK_APP_ID);
    UseWindowFont();
    AppState app;
    const auto programFolder = QCoreApplication::applicationDirPath().toStdString();
    InstallWindowTranslation(WindowLocale(QLocale::system()), programFolder);
    app.ProgramFolder = ListFolderOfThisProgram(programFolder);
    app.FirstOpenFolder = FirstOpenFolder(programFolder, app.ProgramFolder);
    IniSettingsStore store;
    QtDialogs dialogs;
    const SystemClock clock;
    Services services{store, dialogs, clock};
    frmMain window(app, services);
    dialogs.setParent(&window);
    // The icon the desktop's theme has for the entry, so window, dock and menu look alike.
    window.setWindowIcon(QIcon::fromTheme(QUILLMARK_APP_ID, window.windowIcon()));
    window.StartUp(fileArguments(application.arguments()), true);
    return application.exec();
}
