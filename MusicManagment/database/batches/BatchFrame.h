#pragma once

#include <QStringView>
#include <functional>
#include <optional>

#include "MusicManagment/database/batches/BatchSongs.h"
#include "MusicManagment/database/songfiles/SongUpdates.h"

// The frame that all batch commands have in common.

// Headings of the progress window.
struct BatchTexts {
    QStringView All;
    QStringView Marked;
    QStringView One;

    QString Of(BatchRange range) const {
        return (range == BatchRange::All ? All : range == BatchRange::Marked ? Marked : One).toString();
    }
};

// What a song is to become; nothing where it stays as it is.
using SongChange = std::function<std::optional<TID3Tag>(const TID3Tag& song)>;

// Asks for the change of each song, writes tag and record of those that change, renames by the settings, and
// saves where AutoSave is -1. `done` with the number of songs is what undo calls it: "Genre anpassen (40
// Songs)". A database without songs does nothing.
BatchResult RunBatch(TMusicDatabase& database, const BatchSongs& songs, const BatchTexts& texts,
                     const QString& done, const SongChange& change);
// The same for updates that say themselves what becomes of the tags.
using SongUpdateMaker = std::function<std::optional<SongUpdate>(const TID3Tag& song)>;
BatchResult RunUpdates(TMusicDatabase& database, const BatchSongs& songs, const BatchTexts& texts,
                       const QString& done, Renaming renaming, const SongUpdateMaker& maker);
