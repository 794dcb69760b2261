#pragma once

// The windows were drawn for a small dialog font; larger ones would not fit their fixed places.
// Call once the QApplication exists and before any window is built: captions are measured in it.
void UseWindowFont();
