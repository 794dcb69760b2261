// SPDX-License-Identifier: MIT
// The window tests need a QApplication; they run offscreen unless told otherwise.
#include <QApplication>
#include <gtest/gtest.h>

#include "EventLoop.h"
#include "WindowFont.h"

int main(int argc, char** argv)
{
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    UseLeanEventLoop();
    QApplication application(argc, argv);
    UseWindowFont();
    ::testing::InitGoogleTest(&argc, argv);
    return RUN_ALL_TESTS();
}
