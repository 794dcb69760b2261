// SPDX-License-Identifier: MIT
#pragma once

#include <functional>

#include "QmError.h"

// The number of the error that act reports by throwing, 0 when it throws none.
inline int ErrorNumberOf(const std::function<void()>& act)
{
    try {
        act();
        return 0;
    } catch (const QmError& error) {
        return error.number();
    }
}
