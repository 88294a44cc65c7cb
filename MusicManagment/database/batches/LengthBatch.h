#pragma once

#include "MusicManagment/database/batches/BatchSongs.h"
#include "MusicManagment/database/songfiles/SongUpdates.h"

struct LengthBatchResult {
    BatchResult Updates;
    QStringList Damaged;  // path and what is damaged
};

// Looks through the sound of each file from its first byte to its last, on several threads, and corrects
// length, format and bit rate of the records, which get the flag "Korrekte Länge", or "Beschädigt" where the
// sound is. The files are not written. `measure` takes the place of counting frames: the length of a song in
// seconds, 0 where it cannot tell.
using LengthMeasure = std::function<int(const QString& path)>;
LengthBatchResult VerifyLengths(TMusicDatabase& database, const BatchSongs& songs,
                                const LengthMeasure& measure = {});

// Seconds of "4:05", "1:02:03" or "245"; nothing for another text and for more than a record holds.
std::optional<int> ParseLength(const QString& text);
// Asks for the length of a song, writes it, and sets "Korrekte Länge". Nothing happens on cancel.
BatchResult EnterLength(TMusicDatabase& database, SongHandle song);
