// SPDX-License-Identifier: MIT
#include "WindowProgress.h"

#include <QApplication>
#include <QLabel>

namespace {

constexpr qint64 FrameMilliseconds = 16;

} // namespace

// Asked every tenth line, the event loop runs at the screen's pace: a pass through it for each of
// 100,000 asks would take longer than the parse of a million lines itself.
void WindowProgress::processEvents()
{
    if (sinceLastEvents_.isValid() && sinceLastEvents_.elapsed() < FrameMilliseconds)
        return;
    QCoreApplication::processEvents(QEventLoop::ExcludeUserInputEvents);
    sinceLastEvents_.start();
}

void WindowProgress::setBusy(bool busy)
{
    sinceLastEvents_.invalidate(); // the first ask of a parse always passes through the event loop
    if (busy)
        QApplication::setOverrideCursor(Qt::WaitCursor);
    else
        QApplication::restoreOverrideCursor();
}

void WindowProgress::lineProgress(std::size_t linesRead)
{
    if (linesRead != 0 && sinceLastPaint_.isValid() && sinceLastPaint_.elapsed() < FrameMilliseconds)
        return;
    statusLine_.setText(QCoreApplication::translate("WindowProgress", "Parsing file. Line %1. Please wait...")
                            .arg(static_cast<qulonglong>(linesRead)));
    sinceLastPaint_.start();
}
