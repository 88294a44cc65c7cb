#pragma once

#include "MusicManagment/database/batches/BatchSongs.h"
#include "MusicManagment/database/songfiles/SongUpdates.h"

// Setting and removing one of the flags of the songs.

enum class FlagChange { Set, Remove };

// Lets the user choose the flag; nothing on cancel.
std::optional<TSongFlag> AskForFlag(FlagChange change);
// The flag of a name that is offered there, compared exactly.
std::optional<TSongFlag> FlagByName(const QString& name);

// Songs that have the flag already, or do not have it, are not touched.
BatchResult ChangeFlag(TMusicDatabase& database, const BatchSongs& songs, TSongFlag flag, FlagChange change);
