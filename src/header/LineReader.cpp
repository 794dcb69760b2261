// SPDX-License-Identifier: MIT
#include "LineReader.h"

#include <algorithm>
#include <cstring>
#ifdef __SSE2__
#include <emmintrin.h>
#endif

namespace {

// The CRs among 64 bytes, one bit each; high tells whether a byte above 127 is among them.
std::uint64_t crsIn(const char* bytes, bool& high)
{
    std::uint64_t crs = 0;
#ifdef __SSE2__
    const auto cr = _mm_set1_epi8('\r');
    auto any = _mm_setzero_si128();
    for (std::size_t part = 0; part < 64; part += 16) {
        const auto sixteen = _mm_loadu_si128(reinterpret_cast<const __m128i*>(bytes + part));
        crs |= std::uint64_t{static_cast<unsigned>(_mm_movemask_epi8(_mm_cmpeq_epi8(sixteen, cr)))} << part;
        any = _mm_or_si128(any, sixteen);
    }
    high = _mm_movemask_epi8(any) != 0;
#else
    unsigned char any = 0;
    for (std::size_t i = 0; i < 64; ++i) {
        crs |= std::uint64_t{bytes[i] == '\r'} << i;
        any |= static_cast<unsigned char>(bytes[i]);
    }
    high = (any & 0x80) != 0;
#endif
    return crs;
}

std::uint64_t crsIn(const char* bytes)
{
    bool high = false;
    return crsIn(bytes, high);
}

// Whether the CR at cr begins a CR LF between a line that does not end with a blank and one that
// does not begin with one.
bool plainLineEnd(const char* cr) { return cr[1] == '\n' && cr[-1] != ' ' && cr[2] != ' '; }

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

LineReader::PlainLines LineReader::skipPlainLines(std::size_t checkedUpTo, std::size_t enough)
{
    PlainLines passed{0, checkedUpTo};
    const auto from = position_;
    // Each line end is looked at with the byte before and the two after it.
    if (text_.size() < Block + 2 || from == 0 || text_[from] == ' ')
        return passed;
    for (auto block = from; block <= text_.size() - Block - 2 && position_ - from < enough; block += Block) {
        bool high = false;
        auto crs = crsIn(text_.data() + block, high);
        if (high && block + Block > checkedUpTo)
            break;
        for (; crs != 0; crs &= crs - 1) {
            const auto cr = block + static_cast<std::size_t>(__builtin_ctzll(crs));
            if (!plainLineEnd(text_.data() + cr)) {
                block_ = static_cast<std::size_t>(-1); // the blocks read for nextLine are out of date
                return passed;
            }
            position_ = cr + 2;
            ++passed.count;
        }
        // The bytes from here to the position are the LF that ended its last line.
        passed.checkedUpTo = std::max({passed.checkedUpTo, block + Block, position_});
    }
    block_ = static_cast<std::size_t>(-1);
    return passed;
}
