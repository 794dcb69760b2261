// SPDX-License-Identifier: MIT
#include "ClosestWord.h"

#include <algorithm>
#include <numeric>

namespace {

// Levenshtein's distance, one row at a time.
std::size_t editDistance(std::string_view a, std::string_view b)
{
    std::vector<std::size_t> row(b.size() + 1);
    std::iota(row.begin(), row.end(), 0);
    for (std::size_t i = 1; i <= a.size(); ++i) {
        auto diagonal = row[0];
        row[0] = i;
        for (std::size_t j = 1; j <= b.size(); ++j) {
            const auto above = row[j];
            row[j] = std::min({row[j] + 1, row[j - 1] + 1, diagonal + (a[i - 1] == b[j - 1] ? 0 : 1)});
            diagonal = above;
        }
    }
    return row[b.size()];
}

} // namespace

std::string ClosestWord(std::string_view typed, const std::vector<std::string>& words)
{
    std::string closest;
    auto best = typed.size();
    for (const auto& word : words)
        if (const auto distance = editDistance(typed, word); distance < best) {
            best = distance;
            closest = word;
        }
    return best * 2 <= std::max(typed.size(), closest.size()) ? closest : std::string();
}
