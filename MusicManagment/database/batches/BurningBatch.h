#pragma once

#include "MusicManagment/database/batches/BatchSongs.h"
#include "MusicManagment/database/batches/MediaCopies.h"

// Copies songs into a folder from which they are to be burned: those below the root folder of the genres with
// their genre folders, others by their bare names. Songs that lie on a medium already are asked about. A file
// that was in the folder is replaced, but no song of this batch replaces another, and none itself. Tells
// before how much room it takes.
MediaBatchResult PrepareBurning(TMusicDatabase& database, const BatchSongs& songs, const QString& folder);
