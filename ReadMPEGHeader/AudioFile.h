#pragma once

#include "ReadMPEGHeader/SongReading.h"

// The reader behind process-wide results, for one thread: the results of a file are those of the last call.
// Who wants them together with the record takes ReadSong.

// Reads one sound file into `tag`. Returns an empty text, or the refusal of SongReading. Throws EStreamError
// when the file cannot be opened or read; then `tag` holds what was known so far.
QString ReadAudioFile(const QString& path, const ReadOptions& options, TID3Tag& tag);

const MpegResults& LastMpegResults();
const TDebugData& LastDebugData();
