#pragma once

#include <QStringList>
#include <vector>

#include "MusicManagment/database/journal/JournalStep.h"

class TMusicDatabase;

struct AppliedRecords {
    bool IsDone = true;   // false, and nothing has happened, when the database takes no changes now
    QStringList Songs{};  // paths of those that are there afterwards
    int LeftAlone = 0;    // changes of songs that are not there, or are there again already
};

enum class Applying {
    First,
    Again,  // the collection may have some of it already
};

// Makes these changes of songs in a collection, as one edit. A song is found by its path. Of it only those
// members change in which both records differ and which it still has as they were before: what has happened
// to it since, a counted play for example, stays.
AppliedRecords ApplyRecords(TMusicDatabase& database, const std::vector<RecordChange>& changes,
                            Applying how = Applying::First);
// True when the ban list has other entries now; whoever calls tells of it (BannListChanged) once a command.
bool ApplyBans(TMusicDatabase& database, const std::vector<BanChange>& changes);
