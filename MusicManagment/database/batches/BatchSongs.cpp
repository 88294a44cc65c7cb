#include "MusicManagment/database/batches/BatchSongs.h"

using namespace Qt::StringLiterals;

BatchSongs AllSongs(const TMusicDatabase& database) {
    BatchSongs batch{.Range = BatchRange::All, .Songs = {}};
    batch.Songs.reserve(static_cast<std::size_t>(database.Count()));
    for (SongIndex i = 0; i < database.Count(); ++i)
        batch.Songs.push_back(database.Songs().HandleOf(i));
    return batch;
}

BatchSongs MarkedSongs(const ViewSelection& selection) {
    if (selection.Marked.size() == 1) return OneSong(selection.Selected);
    BatchSongs batch{.Range = BatchRange::Marked, .Songs = selection.Marked};
    if (batch.Songs.size() > kMostMarks) {
        batch.Passed = batch.Songs.size() - kMostMarks;
        batch.Songs.resize(kMostMarks);
    }
    return batch;
}

BatchSongs OneSong(SongHandle song) {
    return {.Range = BatchRange::One, .Songs = {song}};
}
