// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <string>

// What the parser tells whoever shows its progress. The core knows no window: the window turns
// these calls into the status line, the busy pointer and the processing of pending events.
class ParseProgress {
public:
    virtual ~ParseProgress() = default;
    virtual void processEvents() {}
    virtual void setBusy(bool /*busy*/) {}
    // Called before lines 1, 11, 21, ... with the number of lines read so far.
    virtual void lineProgress(std::size_t /*linesRead*/) {}
};
