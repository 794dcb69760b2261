// SPDX-License-Identifier: MIT
#pragma once

// The windows were drawn for a small 8 pt dialog font, which they use unless the desktop's font is
// set larger than usual (above 12 pt): a user who asked for large text keeps it, and the windows
// grow with it. Call once the QApplication exists and before any window is built.
void UseWindowFont();
