#pragma once

#include "CommonRUKTools/Listeners.h"
#include "MusicManagment/database/MusicManagment.h"
#include "cli/Console.h"

// The ban list of a command that may change it: read here, and written as soon as a step has changed it.
class BannListKeeper {
 public:
    // There need be no file yet; without a path the list is kept nowhere. Throws EStreamError when it cannot
    // be read.
    BannListKeeper(TMusicDatabase& database, QString path, Console& console);

    // False when it could not be written, which the user has been told.
    bool IsKept() const { return isKept_; }

 private:
    void Save();

    TMusicDatabase& database_;
    QString path_;
    Console& console_;
    bool isKept_ = true;
    Subscription changes_;
};
