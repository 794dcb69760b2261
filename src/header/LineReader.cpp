// SPDX-License-Identifier: MIT
#include "LineReader.h"

#include <cstring>
#ifdef __SSE2__
#include <emmintrin.h>
#endif

namespace {

std::uint64_t crsIn(const char* bytes)
{
    std::uint64_t crs = 0;
#ifdef __SSE2__
    const auto cr = _mm_set1_epi8('\r');
    for (std::size_t part = 0; part < 64; part += 16) {
        const auto sixteen = _mm_loadu_si128(reinterpret_cast<const __m128i*>(bytes + part));
        crs |= std::uint64_t{static_cast<unsigned>(_mm_movemask_epi8(_mm_cmpeq_epi8(sixteen, cr)))} << part;
    }
#else
    for (std::size_t i = 0; i < 64; ++i)
        crs |= std::uint64_t{bytes[i] == '\r'} << i;
#endif
    return crs;
}

} // namespace

void LineReader::loadBlock(std::size_t block)
{
    block_ = block;
    if (text_.size() - block >= Block) {
        crs_ = crsIn(text_.data() + block);
        return;
    }
    char tail[Block] = {};
    std::memcpy(tail, text_.data() + block, text_.size() - block);
    crs_ = crsIn(tail);
}
