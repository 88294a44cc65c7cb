#pragma once

#include <QString>

#include "MusicManagment/database/MusicManagment.h"

// Where the file of a song belongs when its record is `info`, by the settings of the database: the path as it
// is where nothing is to happen, also for a song on a catalogued CD.
QString RenameTarget(const TMusicDatabase& database, const QString& path, const TID3Tag& info);

// The same with a pattern of one's own, whatever `RenameAndMoveMP3s` says.
QString RenameTargetByPattern(const TMusicDatabase& database, const QString& pattern, const QString& path,
                              const TID3Tag& info);
