#pragma once

#include "MusicManagment/database/batches/BatchSongs.h"
#include "MusicManagment/database/songfiles/SongUpdates.h"

// What is done with the tags of many songs as a whole. Neither of these renames a file. Both keep what only
// the collection knows: plays, flags, main genre, time of adding.

// The questions before; true when the user agrees.
bool MayRemoveTags(BatchRange range);
bool MayRereadTags(BatchRange range);

// Takes ID3v1, ID3v2 and the tag behind the audio out of the files, with their pictures; an APE tag stays.
// The records get title and artist of the files' names.
BatchResult RemoveTags(TMusicDatabase& database, const BatchSongs& songs);

// Takes texts and technical data from the files again, which several threads read.
BatchResult RereadTags(TMusicDatabase& database, const BatchSongs& songs);
