#include "MusicManagment/database/songfiles/Removal.h"

#include <algorithm>

namespace {

// The positions of many paths in one walk over the list.
std::vector<SongIndex> PositionsOf(const TMusicDatabase& database, const QStringList& paths) {
    const QSet<QString> wanted(paths.begin(), paths.end());
    std::vector<SongIndex> positions;
    SongIndex index = 0;
    for (const auto& song : database.Songs()) {
        if (wanted.contains(song->FileName)) positions.push_back(index);
        ++index;
    }
    return positions;
}

}  // namespace

RemovedSongs RemoveSongs(TMusicDatabase& database, const QStringList& paths) {
    return RemoveSongs(database, PositionsOf(database, paths));
}

RemovedSongs RemoveSongs(TMusicDatabase& database, std::vector<SongIndex> positions) {
    // From the end, so that the positions in front stay right.
    std::sort(positions.rbegin(), positions.rend());
    RemovedSongs removed;
    for (const SongIndex index : positions) {
        if (index < 0 || index >= database.Count()) continue;
        TID3Tag record = database.Song(index);
        if (database.RemoveEntry(index)) removed.push_back(std::move(record));
    }
    return removed;
}

int RestoreSongs(TMusicDatabase& database, const RemovedSongs& songs) {
    int restored = 0;
    for (const TID3Tag& song : songs) {
        if (database.Contains(song.FileName)) continue;
        if (database.AddEntry(song.FileName, song, {.SkipDiskChecks = true}) >= 0) ++restored;
    }
    return restored;
}
