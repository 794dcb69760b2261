// SPDX-License-Identifier: MIT
#pragma once

#include "Clock.h"

// A clock that tells the time it is set to.
class FixedClock : public Clock {
public:
    explicit FixedClock(LocalDateTime time = {2008, 8, 10, 14, 5, 9}) : time_(time) {}
    LocalDateTime now() const override { return time_; }
    void set(LocalDateTime time) { time_ = time; }

private:
    LocalDateTime time_;
};
