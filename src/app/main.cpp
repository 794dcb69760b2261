// SPDX-License-Identifier: MIT
// Quillmark: the window program.
#include <QApplication>
#include <QIcon>
#include <QTimer>
#include <cstring>
#include <iostream>

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

// --help and --version answer without a display; any other first argument is the file to open.
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
                     "  --version  show the version and exit\n\n"
                     "quillmark-cli runs the same checks and saves from the command line.\n";
        return true;
    }
    return false;
}

} // namespace

int main(int argc, char** argv)
{
    if (answeredOnTheCommandLine(argc, argv))
        return 0;
    UseLeanEventLoop();
    QApplication application(argc, argv); // takes Qt's own options (-platform, -style, ...) out of argv
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
    window.StartUp(application.arguments().mid(1));
    // Once the window manager has placed the window, so that the preferences show over it.
    QTimer::singleShot(0, &window, [&window] { window.OfferPreferencesWithoutNames(); });
    return application.exec();
}
