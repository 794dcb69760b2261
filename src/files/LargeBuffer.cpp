#include "LargeBuffer.h"

#include <cstdint>
#include <sys/mman.h>

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
