#pragma once

#include <QtGlobal>

#include "MusicManagment/database/SongList.h"

class TMusicDatabase;

// Sets or removes a flag of one song, in its file too, and tells the user where that fails. Throws what
// UpdateSongs throws.
void SetSongFlag(TMusicDatabase& database, SongHandle song, quint32 flag, bool on);
