#pragma once

#include <QString>
#include <QStringList>

#include "CommonRUKTools/FileSource.h"
#include "ReadMPEGHeader/ID3Tag.h"
#include "ReadMPEGHeader/id3v2/FrameListener.h"

// How tags and frames are looked for.
enum class ReadProfile {
    Classic,  // the program's original rules: plain ID3v2.3 layout, first frame sync wins
    Modern,   // ID3v2.2 to 2.4 with all their options, confirmed frame syncs
};

struct ReadOptions {
    ReadProfile Profile = ReadProfile::Classic;
    bool RemoveJunkTexts = false;       // discard titles and artists that are advertising or place-holders
    bool TakeTrackNumbers = false;      // a leading "(7)" of a title becomes the track
    QStringList ExcludedArtistFolders;  // names in capitals of folders that must not become an artist
    double FileTime = -1;               // day count for the record's AddTime; -1: now
    FrameListener OnFrame;
};

// Reads one sound file into `tag`: technical data, tags, or what its name tells. Returns an empty text, or
// why nothing was read: "Keine Datei angegeben", "CD nicht eingelegt" (path begins with ':'), "Datei nicht
// gefunden". Throws EStreamError when the file cannot be opened or read; then `tag` holds what was known so
// far. Not re-entrant: the results in MpegResults.h are process-wide.
QString ReadAudioFile(const QString& path, const ReadOptions& options, TID3Tag& tag);

// The same for bytes that are open already; `path` only gives the name. Throws EMediumError when the medium
// fails. A damaged tag or header is no failure: what it would have told is missing, and the diagnostics say
// so.
void ReadAudioStream(ByteSource& source, const QString& path, const ReadOptions& options, TID3Tag& tag);

// What the last read could not make sense of, one remark a line; empty when all was well.
struct TDebugData {
    QString Text;
};

// Process-wide, as the results in MpegResults.h.
const TDebugData& LastDebugData();
