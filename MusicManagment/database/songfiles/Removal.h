#pragma once

#include <QString>
#include <QStringList>
#include <vector>

#include "MusicManagment/database/CollectionEdit.h"

// Takes songs out of the collection; their files stay.

// The records as they were, for bringing them back.
using RemovedSongs = std::vector<TID3Tag>;

// By handle, by path or by position; positions may come in any order. Songs that are not there are passed
// over; nothing is removed while the database takes no changes.
RemovedSongs RemoveSongs(TMusicDatabase& database, const std::vector<SongHandle>& songs);
RemovedSongs RemoveSongs(TMusicDatabase& database, const QStringList& paths);
RemovedSongs RemoveSongs(TMusicDatabase& database, const std::vector<SongIndex>& positions);

// Brings songs back, also those whose files are gone meanwhile. Returns how many; those that are in the
// collection again already are passed over.
int RestoreSongs(TMusicDatabase& database, const RemovedSongs& songs);
