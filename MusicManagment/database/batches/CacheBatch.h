#pragma once

#include "MusicManagment/database/batches/BatchSongs.h"
#include "MusicManagment/database/batches/MediaCopies.h"

// Copies of songs on media, put on the disk so that they can be played without the medium.

// Copies those that have no copy yet to their places, medium by medium. A file that is there already counts
// as the copy and is not touched. After a copy that fails the user is asked whether to go on; with
// QuietBatches it goes on. Tells before how much room it takes.
MediaBatchResult CacheSongs(TMusicDatabase& database, const BatchSongs& songs);

// Removes the copies that CacheSongs has made; with all songs also of songs that are not in the collection
// any more. One that has become a song of the collection itself stays.
MediaBatchResult DropCaches(TMusicDatabase& database, const BatchSongs& songs);
