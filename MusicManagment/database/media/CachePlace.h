#pragma once

#include "MusicManagment/database/MusicManagment.h"

// Copies of songs on media, put on the disk so that they can be played without the medium.

// Where the copy of a song belongs, by its genre and the pattern of the names.
QString CachePlace(const TMusicDatabase& database, const TID3Tag& song);

// The copy of a song that is there: at its place, converted to .wma there, or where we have put it before its
// tags changed. Empty where there is none, and for a path that is not in the collection.
QString CachedCopy(const TMusicDatabase& database, const QString& cdPath);

// The copies that we have made, noted in the side file: song and copy.
inline const QString kCacheSection = QStringLiteral("cache");

// The user's own files of songs that were tied to a backup medium, noted as well: they are found like copies,
// and never removed.
void NoteOwnFile(TMusicDatabase& database, const QString& cdPath, const QString& file);
std::vector<SideRow> OwnFiles(const TMusicDatabase& database);

// Noted copies and own files of a song.
QStringList NotedFiles(const TMusicDatabase& database, const QString& cdPath);
