// Times the window's Open command on a part file, from the command to the end of the open,
// offscreen: window_open_bench FILE. Prints the seconds of the fastest of five opens.
#include <QApplication>

#include "EventLoop.h"
#include <QElapsedTimer>
#include <QTemporaryDir>
#include <algorithm>
#include <cstdio>

#include "AppState.h"
#include "Clock.h"
#include "Dialogs.h"
#include "IniSettingsStore.h"
#include "frmMain.h"

int main(int argc, char** argv)
{
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    UseLeanEventLoop();
    QApplication application(argc, argv);
    if (argc != 2) {
        std::fprintf(stderr, "usage: window_open_bench FILE\n");
        return 2;
    }
    QTemporaryDir settingsFolder;
    AppState app;
    app.ProgramFolder = QCoreApplication::applicationDirPath().toStdString();
    IniSettingsStore store((settingsFolder.path() + "/Quillmark.ini").toStdString());
    DefaultAnswers dialogs;
    const SystemClock clock;
    Services services{store, dialogs, clock};
    frmMain window(app, services);
    window.StartUp({});
    qint64 best = -1;
    for (int run = 0; run < 5; ++run) {
        app.PendingFile = argv[1];
        QElapsedTimer timer;
        timer.start();
        window.MDateiOeffnen_Click();
        const auto elapsed = timer.nsecsElapsed();
        best = best < 0 ? elapsed : std::min(best, elapsed);
    }
    std::printf("%.4f\n", static_cast<double>(best) / 1e9);
    return 0;
}
