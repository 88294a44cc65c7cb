#pragma once

#include "MusicManagment/database/MusicManagment.h"
#include "cli/Console.h"

enum class StopBy {
    Nothing,
    Interrupt,  // Ctrl-C stops the operation at its next progress point
};

// Follows the long operations of a database while it exists: shows how far they are where the error stream is
// a terminal, and passes the user's wish to stop on.
class RunWatcher {
 public:
    RunWatcher(TMusicDatabase& database, Console& console, StopBy stopBy);
    ~RunWatcher();
    RunWatcher(const RunWatcher&) = delete;
    RunWatcher& operator=(const RunWatcher&) = delete;

 private:
    void Show(const ProgressPoint& point);
    void Print(const QString& text);
    void Erase();

    TMusicDatabase& database_;
    std::FILE* terminal_;  // nullptr: nobody watches
    qint64 nextShow_;      // ticks of the clock
    qsizetype shown_ = 0;  // characters that stand in the line
};
