// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <functional>
#include <ostream>

#include "FileReport.h"

// Works on count files on threads threads and hands each report to emit in the files' order, on
// the calling thread, as soon as it and all before it are done: the output is the same as with
// one thread. While it works, a progress line (files done of all, files per second) is redrawn
// in place on progress when that is given, and cleared at the end. No file is begun once emit
// returned false or an interrupt is pending; the files begun are finished and emitted. False
// when the run ended early.
bool RunInOrder(std::size_t count, unsigned threads, const std::function<FileReport(std::size_t)>& work,
                const std::function<bool(FileReport&)>& emit, std::ostream* progress);

// Ctrl+C (SIGINT) and SIGTERM end a run between files, never in the middle of a file's save:
// they are held back for the whole process (call this before any thread starts) and looked at
// before each file is begun.
void HoldInterrupts();
bool InterruptPending();

// The most threads a run may be asked for.
inline constexpr unsigned MaxThreads = 1024;

// The threads to use: the number asked for, or one per core when it is 0.
unsigned ThreadsFor(unsigned asked);
