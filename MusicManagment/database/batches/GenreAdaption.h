#pragma once

#include "MusicManagment/database/batches/BatchSongs.h"
#include "MusicManagment/database/songfiles/SongUpdates.h"

struct GenreAdaption {
    BatchResult Updates;
    QStringList WithoutGenre;  // artist and title of the songs for which there was none
};

// Gives songs without a main genre that of another song of the same artist, and its spelling of the artist;
// where there is none, of a song whose artist is most alike, if the user agrees. With `QuietBatches` the user
// is asked once an artist, and the songs for which there is no genre are told in the result, else in a
// message each.
GenreAdaption AdaptGenres(TMusicDatabase& database, const BatchSongs& songs);
