#pragma once

#include "MusicManagment/database/batches/BatchSongs.h"
#include "MusicManagment/database/songfiles/SongUpdates.h"

struct LengthBatchResult {
    BatchResult Updates;
    QStringList Damaged;  // path and what is damaged
    QString Remark;       // why it was not done as the setting has it; empty when it was
};

// Looks through the sound of each file from its first byte to its last, on several threads, and corrects
// length, format and bit rate of the records, which get the flag "Korrekte Länge", and "Beschädigt" where the
// sound is. With UseWinAmpForLenCheck the lengths are those that OnMeasureLength tells, and nothing else is
// looked at; frames are counted all the same where nobody can be asked. The files are not written.
LengthBatchResult VerifyLengths(TMusicDatabase& database, const BatchSongs& songs);

// Seconds of "4:05", "1:02:03" or "245"; nothing for another text and for more than a record holds.
std::optional<int> ParseLength(const QString& text);
// Asks for the length of a song, writes it, and sets "Korrekte Länge". Nothing happens on cancel.
BatchResult EnterLength(TMusicDatabase& database, SongHandle song);
