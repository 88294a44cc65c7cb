#pragma once

#include <QString>
#include <vector>

#include "MusicManagment/database/batches/BatchSongs.h"
#include "MusicManagment/database/songfiles/NameMatch.h"
#include "MusicManagment/database/songfiles/SongUpdates.h"

// Tags from the names of the files, as a pattern reads them (NameMatch.h).

// What that comes to for a song, before anything happens.
struct PlannedTags {
    SongHandle Song{};
    NameReading Reading{};
    bool Changes = false;  // false also where something is in the way
};

// One for each song that is still there.
std::vector<PlannedTags> PlanTagsFromNames(const TMusicDatabase& database,
                                           const std::vector<SongHandle>& songs, const NameMatcher& matcher);

// Changes tags and records of the songs whose names fit and say something new. The files keep their names
// whatever the settings say: what was just read from a name is not to change it.
BatchResult TakeTagsFromNames(TMusicDatabase& database, const BatchSongs& songs, const NameMatcher& matcher);
