// SPDX-License-Identifier: MIT
#include "FileLines.h"

#include <algorithm>

std::size_t FileLines::fileLineOf(std::size_t index) const
{
    const auto after = std::upper_bound(runs_.begin(), runs_.end(), index,
                                        [](std::size_t i, const Run& run) { return i < run.first; });
    if (after == runs_.begin())
        return 0;
    const auto& run = *(after - 1);
    return run.fileLine + (index - run.first);
}
