// SPDX-License-Identifier: MIT
#include "LargeBuffer.h"

#include <cstdint>
#include <sys/mman.h>
#include <unistd.h>

void AdviseLargeBuffer(void* buffer, std::size_t size)
{
#ifdef MADV_HUGEPAGE
    constexpr std::uintptr_t LargePage = std::uintptr_t{2} * 1024 * 1024;
    const auto start = reinterpret_cast<std::uintptr_t>(buffer);
    const auto alignedStart = (start + LargePage - 1) & ~(LargePage - 1);
    const auto alignedEnd = (start + size) & ~(LargePage - 1);
    if (alignedEnd > alignedStart)
        ::madvise(reinterpret_cast<void*>(alignedStart), alignedEnd - alignedStart, MADV_HUGEPAGE);
#else
    (void)buffer;
    (void)size;
#endif
}

void ReleaseLargeBufferPages(char* begin, char* end)
{
    const auto pageSize = static_cast<std::uintptr_t>(::sysconf(_SC_PAGESIZE));
    const auto first = (reinterpret_cast<std::uintptr_t>(begin) + pageSize - 1) & ~(pageSize - 1);
    const auto last = reinterpret_cast<std::uintptr_t>(end) & ~(pageSize - 1);
    if (last > first)
        ::madvise(reinterpret_cast<void*>(first), last - first, MADV_DONTNEED);
}
