#pragma once

#include <cerrno>
#include <csignal>

#include "CommonRUKTools/WriteGate.h"

#ifndef Q_OS_WIN
#include <unistd.h>
#endif

// Stands before every step on the disk for its own lifetime: counts them, and lets one of them fail or ends
// the process before it. Writes come in small pieces, so that there are steps in their middle.
class StepGate : public WriteGate {
 public:
    enum class Then { Fails, FailsFromThere, Dies };

    // At the step of this number, from 0; at none.
    StepGate() { SetWriteGate(this); }
    StepGate(int at, Then then) : at_(at), then_(then) { SetWriteGate(this); }
    ~StepGate() override { SetWriteGate(nullptr); }

    int Before(DiskStep step, const QString&) override {
        if (step == DiskStep::Move && BetweenFileSystems) return EXDEV;
        if (then_ != Then::Dies && !NeedsRoom(step)) return 0;
        const int number = Steps++;
        if (at_ < 0 || number < at_ || (number > at_ && then_ == Then::Fails)) return 0;
#ifndef Q_OS_WIN
        if (then_ == Then::Dies) ::kill(::getpid(), SIGKILL);
#endif
        return ENOSPC;
    }
    std::size_t LongestWrite() const override {
        return 700;
    }
    bool WaitsForDisk() const override {
        return false;
    }

    int Steps = 0;
    bool BetweenFileSystems = false;  // every move leads to another one

 private:
    static bool NeedsRoom(DiskStep step) {
        return step == DiskStep::Create || step == DiskStep::Write || step == DiskStep::Resize ||
               step == DiskStep::Flush || step == DiskStep::Folder || step == DiskStep::TakeName;
    }

    int at_ = -1;
    Then then_ = Then::Dies;
};
