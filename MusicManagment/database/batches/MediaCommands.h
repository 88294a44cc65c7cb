#pragma once

#include "MusicManagment/database/batches/BatchSongs.h"

// The commands about songs on media, for the songs that a view has marked or for all. Each asks and tells
// what there is to ask and to tell.
void CacheSongsCommand(TMusicDatabase& database, const BatchSongs& songs);
void DropCachesCommand(TMusicDatabase& database, const BatchSongs& songs);
// The folder in which songs now wait to be burnt; empty where none does.
QString PrepareBurningCommand(TMusicDatabase& database, const BatchSongs& songs);
// Lets the user choose a medium, of those that have a name, that songs lie on, or that are mounted, and name
// it.
void NameMediaCommand(TMusicDatabase& database);
