#include "WindowProgress.h"

#include <QApplication>
#include <QLabel>

namespace {

constexpr qint64 FrameMilliseconds = 16;

} // namespace

void WindowProgress::processEvents() { QCoreApplication::processEvents(QEventLoop::ExcludeUserInputEvents); }

void WindowProgress::setBusy(bool busy)
{
    if (busy)
        QApplication::setOverrideCursor(Qt::WaitCursor);
    else
        QApplication::restoreOverrideCursor();
}

void WindowProgress::lineProgress(std::size_t linesRead)
{
    if (linesRead != 0 && sinceLastPaint_.isValid() && sinceLastPaint_.elapsed() < FrameMilliseconds)
        return;
    statusLine_.setText(QString::fromStdString(ProgressCaption(linesRead)));
    sinceLastPaint_.start();
}
