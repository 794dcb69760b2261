// Quillmark: the window program.
#include <QApplication>

#include "EventLoop.h"

#include "AppState.h"
#include "Clock.h"
#include "IniSettingsStore.h"
#include "QtDialogs.h"
#include "WindowFont.h"
#include "frmMain.h"

int main(int argc, char** argv)
{
    UseLeanEventLoop();
    QApplication application(argc, argv); // takes Qt's own options (-platform, -style, ...) out of argv
    UseWindowFont();
    AppState app;
    app.ProgramFolder = QCoreApplication::applicationDirPath().toStdString();
    IniSettingsStore store;
    QtDialogs dialogs;
    const SystemClock clock;
    Services services{store, dialogs, clock};
    frmMain window(app, services);
    dialogs.setParent(&window);
    window.StartUp(application.arguments().mid(1));
    return application.exec();
}
