#pragma once

#include <QString>

#include "MusicManagment/database/SongTypes.h"

class TMusicDatabase;

// "1 Song", "2 Songs"
QString SongCountText(std::size_t count);
// "2 Songs, Spielzeit 7:05"
QString TotalsText(qint64 songs, qint64 seconds);

// How long all songs together play. Follows insertions song by song; after any other change the songs are
// added up anew when the sum is asked for.
class CollectionTotals {
 public:
    explicit CollectionTotals(const TMusicDatabase& database) : database_(database) {}

    void SongChanged(SongIndex index, TChangeType change);
    qint64 Seconds();
    QString Text();

 private:
    const TMusicDatabase& database_;
    qint64 seconds_ = 0;
    bool stale_ = true;
};
