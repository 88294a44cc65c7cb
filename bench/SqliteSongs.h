#pragma once

#include <QString>
#include <vector>

#include "MusicManagment/database/SongList.h"

// Songs in a SQLite table: what a general database makes of the same rows.
void WriteSqliteSongs(const QString& path, const SongList& songs);
std::vector<TID3Tag> ReadSqliteSongs(const QString& path);
