#pragma once

#include <QString>

#include "CommonRUKTools/Listeners.h"
#include "MusicManagment/database/SongTypes.h"

class TMusicDatabase;

// "2 Songs, Spielzeit 7:05"
QString TotalsText(qint64 songs, qint64 seconds);

// How long all songs together play. Follows the collection song by song; when others have come all at once
// they are added up anew as the sum is asked for.
class CollectionTotals {
 public:
    explicit CollectionTotals(TMusicDatabase& database);

    qint64 Seconds();
    QString Text();

 private:
    const TMusicDatabase& database_;
    qint64 seconds_ = 0;
    bool stale_ = true;
    Subscriptions subscriptions_;
};
