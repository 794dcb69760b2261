// SPDX-License-Identifier: MIT
#pragma once

#include <QElapsedTimer>

#include "ParseProgress.h"

class QLabel;

// Shows the parser's progress in the status line. The caption changes every tenth line, but the
// label is painted, and pending events are processed, at the screen's pace: a repaint for each of
// 100,000 captions would cost more than the parse. User input waits until the open has ended, so
// no command runs inside it.
class WindowProgress : public ParseProgress {
public:
    explicit WindowProgress(QLabel& statusLine) : statusLine_(statusLine) {}

    void processEvents() override;
    void setBusy(bool busy) override;
    void lineProgress(std::size_t linesRead) override;

private:
    QLabel& statusLine_;
    QElapsedTimer sinceLastPaint_;
    QElapsedTimer sinceLastEvents_;
};
