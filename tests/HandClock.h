#pragma once

#include "CommonRUKTools/Clock.h"

// The program's clock while it lives: time stands still until a test moves it on.
class HandClock : public Clock {
 public:
    HandClock() { SetClock(this); }
    ~HandClock() override { SetClock(nullptr); }
    HandClock(const HandClock&) = delete;
    HandClock& operator=(const HandClock&) = delete;

    mutable qint64 Milliseconds = 1'000'000;
    qint64 Step = 0;  // ms that pass at every look
    double Day = 45'000.25;

    qint64 Ticks() const override { return Milliseconds += Step; }
    double Now() const override { return Day; }
};
