#pragma once

#include <QString>

#include "MusicManagment/database/SongTypes.h"

class TMusicDatabase;

// One progress point of a long operation. A maximum of -1 means unknown.
struct ProgressPoint {
    qint64 Cur = -1;
    qint64 Max = -1;
    qint64 CurSub = -1;
    qint64 MaxSub = -1;
    TProgressType Type = ptOther;
    QString Description{};
};

// A long operation of the database: begins with the object and ends with it, on every way out.
class ProgressRun {
 public:
    // Throws EAbort, after telling the user, when another run is going.
    ProgressRun(TMusicDatabase& database, const QString& description, bool lockMenu = true);
    ~ProgressRun();
    ProgressRun(const ProgressRun&) = delete;
    ProgressRun& operator=(const ProgressRun&) = delete;

 private:
    TMusicDatabase& database_;
    bool lockMenu_;
};

// For a command that empties or creates something before its own run begins. Throws EAbort, after telling the
// user, when a run is going.
void RefuseDuringRun(TMusicDatabase& database);
