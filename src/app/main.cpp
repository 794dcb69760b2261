// Quillmark: the window program.
#include <QApplication>

#include "EventLoop.h"
#include <QFont>

#include "AppState.h"
#include "Clock.h"
#include "IniSettingsStore.h"
#include "QtDialogs.h"
#include "frmMain.h"

int main(int argc, char** argv)
{
    UseLeanEventLoop();
    QApplication application(argc, argv); // takes Qt's own options (-platform, -style, ...) out of argv
    // The windows were drawn for a small dialog font; larger ones would not fit their fixed places.
    QFont font = QApplication::font();
    font.setPointSizeF(8);
    QApplication::setFont(font);
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
