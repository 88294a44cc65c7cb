#pragma once

#include "CommonRUKTools/ByteReader.h"

class TMusicDatabase;

// Song records of the versions 1.0 to 1.2: a path and a few numbers; the rest is read from the audio file.

// Bytes of a record.
std::size_t OldRecordSize(int version);

// Adds the song. False when it was refused: its file is gone, or the song is banned. With `isCounted` the
// group lists were read from the file and already count it.
bool AddOldSong(TMusicDatabase& database, ByteSpan bytes, int version, bool isCounted);
