#pragma once

#include <QString>

#include "MusicManagment/database/Operation.h"

class TMusicDatabase;

// A long operation of the database: begins with the object and ends with it, on every way out.
class ProgressRun {
 public:
    // Throws EAbort, after telling the user, when another run is going.
    ProgressRun(TMusicDatabase& database, const QString& description,
                Operation::Commands commands = Operation::Commands::Rest);
    ~ProgressRun() { operation_.End(); }
    ProgressRun(const ProgressRun&) = delete;
    ProgressRun& operator=(const ProgressRun&) = delete;

 private:
    Operation& operation_;
};

// For a command that empties or creates something before its own run begins. Throws EAbort, after telling the
// user, when a run is going.
void RefuseDuringRun(TMusicDatabase& database);
