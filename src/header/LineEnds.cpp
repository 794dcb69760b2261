// SPDX-License-Identifier: MIT
#include "LineEnds.h"

#include <cstring>

#include "LineReader.h"
#include "Text.h"

bool IsUnixLineEnd(std::string_view text)
{
    LineReader reader(text);
    return !reader.atEnd() && reader.nextLine().find('\n') != std::string_view::npos;
}

namespace {

// Moves text[start, end) so that it ends at target (target >= end), returning its new start.
std::size_t moveBack(std::string& text, std::size_t start, std::size_t end, std::size_t target)
{
    const auto length = end - start;
    std::memmove(text.data() + target - length, text.data() + start, length);
    return target - length;
}

} // namespace

// Both conversions below work from the end of the text toward its start, so that a byte is read
// before anything is written over it.
void LfToCrLf(std::string& text)
{
    std::size_t bareLfs = 0;
    for (auto lf = text.find('\n'); lf != std::string::npos; lf = text.find('\n', lf + 1))
        bareLfs += lf == 0 || text[lf - 1] != '\r';
    auto end = text.size();
    text.resize(text.size() + bareLfs);
    auto target = text.size();
    while (target > end) {
        const auto lf = text.rfind('\n', end - 1);
        target = moveBack(text, lf, end, target);
        end = lf;
        if (lf == 0 || text[lf - 1] != '\r')
            text[--target] = '\r';
    }
}

void WidenLoneCrs(std::string& text, std::size_t from, std::size_t gap)
{
    const auto size = text.size();
    const auto loneAt = [&text, size](std::size_t cr) { return cr + 1 == size || text[cr + 1] != '\n'; };
    std::size_t loneCrs = 0;
    for (auto cr = text.find('\r', from); cr != std::string::npos; cr = text.find('\r', cr + 1))
        loneCrs += loneAt(cr);
    text.resize(size + gap + loneCrs);
    auto target = text.size();
    auto end = size;
    auto searchEnd = size; // the CRs below this position are still to be moved
    while (end > from) {
        const auto cr = searchEnd > from ? text.rfind('\r', searchEnd - 1) : std::string::npos;
        const bool atCr = cr != std::string::npos && cr >= from;
        const bool lone = atCr && loneAt(cr);
        const auto start = atCr ? cr + 1 : from;
        target = moveBack(text, start, end, target);
        end = start;
        searchEnd = atCr ? cr : from;
        if (lone)
            text[--target] = '\n';
    }
}

std::string ReplaceAll(std::string_view text, std::string_view search, std::string_view replacement)
{
    if (search.empty())
        return std::string(text);
    std::string result;
    result.reserve(text.size());
    std::size_t copiedUpTo = 0;
    for (auto found = text.find(search); found != std::string_view::npos; found = text.find(search, copiedUpTo)) {
        result.append(text, copiedUpTo, found - copiedUpTo);
        result.append(replacement);
        copiedUpTo = found + search.size();
    }
    result.append(text, copiedUpTo);
    return result;
}
