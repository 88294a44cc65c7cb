#pragma once

#include "CommonRUKTools/ByteReader.h"

class TMusicDatabase;

// Song records of the versions 1.0 to 1.2: a path and a few numbers; the rest is read from the audio file.

// Bytes of a record.
std::size_t OldRecordSize(int version);

// Songs whose record alone is not enough.
struct LostSongs {
    int Kept = 0;  // taken over without what their files would tell
    int Left = 0;  // not taken over: the file is gone, or the song is banned
};

// Adds the song. One whose file is gone is left out unless the database keeps lost songs. With `isCounted`
// the group lists were read from the file and already count it.
void AddOldSong(TMusicDatabase& database, ByteSpan bytes, int version, bool isCounted, LostSongs& lost);
