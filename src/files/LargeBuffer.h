// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>

// Tells the system that a freshly allocated buffer of many megabytes will be filled at once, so
// that it backs it with large pages: faulting in a 50 MB body page by page costs more than
// parsing it. Small buffers and systems without the advice are left as they are.
void AdviseLargeBuffer(void* buffer, std::size_t size);

// Gives the whole pages between begin and end back to the system while the buffer stays
// allocated: for bytes that are read and will never be read again. Written to later, such a
// page comes back filled with zeros.
void ReleaseLargeBufferPages(char* begin, char* end);
