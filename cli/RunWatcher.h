#pragma once

#include "MusicManagment/database/MusicManagment.h"
#include "cli/Console.h"
#include "cli/TransientLine.h"

enum class StopBy {
    Nothing,
    Interrupt,  // Ctrl-C stops the operation at its next progress point
};

// Follows the long operations of a database while it exists: shows how far they are where the error stream is
// a terminal, and passes the user's wish to stop on.
class RunWatcher {
 public:
    RunWatcher(TMusicDatabase& database, Console& console, StopBy stopBy);

 private:
    void Show(const ProgressPoint& point);

    TMusicDatabase& database_;
    TransientLine line_;
    qint64 nextShow_;  // ticks of the clock
    Subscriptions watched_;
};
