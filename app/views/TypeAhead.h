#pragma once

#include <QString>
#include <QtGlobal>

class FilteredSongs;
struct SongColumn;

// Finds songs by the letters that the user types on the list: those that come quickly one after the other
// belong together, the same letter again goes to the next song.
class TypeAhead {
 public:
    // The next row whose text in the column begins with what has been typed, `letters` last; case and umlauts
    // do not matter. From `current` on (-1 none) and round the end; -1 when there is none.
    int Next(const FilteredSongs& songs, const SongColumn& column, int current, const QString& letters);

 private:
    QString typed_;       // folded
    qint64 lastKey_ = 0;  // ticks of the clock
};
