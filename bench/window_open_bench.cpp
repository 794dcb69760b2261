// SPDX-License-Identifier: MIT
// Times the window's Open command on a part file, from the command to the end of the open,
// offscreen: window_open_bench FILE. Prints the median seconds of nine opens.
#include <QApplication>

#include "EventLoop.h"
#include <QElapsedTimer>
#include <QTemporaryDir>
#include <algorithm>
#include <cstdio>
#include <vector>

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
    std::vector<qint64> elapsed;
    for (int run = 0; run < 9; ++run) {
        app.PendingFile = argv[1];
        QElapsedTimer timer;
        timer.start();
        window.MDateiOeffnen_Click();
        elapsed.push_back(timer.nsecsElapsed());
    }
    std::nth_element(elapsed.begin(), elapsed.begin() + 4, elapsed.end());
    std::printf("%.4f\n", static_cast<double>(elapsed[4]) / 1e9);
    return 0;
}
