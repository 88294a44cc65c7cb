#include "MusicManagment/database/songfiles/Removal.h"

#include <QSet>

RemovedSongs RemoveSongs(TMusicDatabase& database, const std::vector<SongHandle>& songs) {
    CollectionEdit edit(database);
    for (const SongHandle song : songs)
        edit.Remove(song);
    edit.Commit();
    RemovedSongs removed;
    for (const SongEdit& done : edit.Done())
        removed.push_back(*done.Before);
    return removed;
}

RemovedSongs RemoveSongs(TMusicDatabase& database, const QStringList& paths) {
    const QSet<QString> wanted(paths.begin(), paths.end());
    std::vector<SongHandle> songs;
    for (const auto& song : database.Songs())
        if (wanted.contains(song->FileName)) songs.push_back(database.Songs().HandleOf(*song));
    return RemoveSongs(database, songs);
}

RemovedSongs RemoveSongs(TMusicDatabase& database, const std::vector<SongIndex>& positions) {
    std::vector<SongHandle> songs;
    for (const SongIndex index : positions)
        if (index >= 0 && index < database.Count()) songs.push_back(database.Songs().HandleOf(index));
    return RemoveSongs(database, songs);
}

int RestoreSongs(TMusicDatabase& database, const RemovedSongs& songs) {
    int restored = 0;
    for (const TID3Tag& song : songs) {
        if (database.Contains(song.FileName)) continue;
        if (database.AddEntry(song.FileName, song, AddAs::Returning) >= 0) ++restored;
    }
    return restored;
}
