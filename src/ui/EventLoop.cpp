// SPDX-License-Identifier: MIT
#include "EventLoop.h"

#include <QByteArray>
#include <QtGlobal>

void UseLeanEventLoop()
{
    if (!qEnvironmentVariableIsSet("QT_NO_GLIB"))
        qputenv("QT_NO_GLIB", QByteArray("1"));
}
