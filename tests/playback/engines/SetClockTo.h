#pragma once

#include "CommonRUKTools/Clock.h"

// The engine's clock, set by the test.
class SetClockTo : public Clock {
 public:
    SetClockTo() { SetClock(this); }
    ~SetClockTo() override { SetClock(nullptr); }
    SetClockTo(const SetClockTo&) = delete;
    SetClockTo& operator=(const SetClockTo&) = delete;
    qint64 Ticks() const override { return ticks; }
    double Now() const override { return 0; }

    qint64 ticks = 1000;
};
