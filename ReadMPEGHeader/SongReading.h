#pragma once

#include <QString>
#include <QStringList>

#include "CommonRUKTools/FileSource.h"
#include "ReadMPEGHeader/ID3Tag.h"
#include "ReadMPEGHeader/id3v2/FrameListener.h"
#include "ReadMPEGHeader/mpeg/MpegResults.h"

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
    bool DeriveMainGenre = false;       // from the tag's genre where the record has no main genre
    double FileTime = -1;               // day count for the record's AddTime; -1: now
    FrameListener OnFrame;              // called in the thread that reads
};

// What a reading could not make sense of, one remark a line; empty when all was well.
struct TDebugData {
    QString Text{};
};

// What became of one sound file.
struct SongReading {
    TID3Tag Tag{};       // technical data, tags, or what the name tells; after an error what was known so far
    MpegResults Mpeg{};  // what the analysis of the first frame found beside the record
    TDebugData Remarks{};  // a damaged tag or header is no failure: what it would have told is missing
    // Why nothing was read: "Keine Datei angegeben", "CD nicht eingelegt" (path begins with ':'), "Datei
    // nicht gefunden".
    QString Refusal{};
    QString Error{};  // why the file could not be opened or read to its end; empty for a refusal

    bool Succeeded() const { return Refusal.isEmpty() && Error.isEmpty(); }
    const QString& Failure() const { return Refusal.isEmpty() ? Error : Refusal; }
};

// Reads one sound file. Keeps no state: any number of threads may read at the same time, as long as nobody
// changes the legacy code page or the clock meanwhile. Throws only what `OnFrame` throws.
SongReading ReadSong(const QString& path, const ReadOptions& options);
// The same for bytes that are open already; `path` only gives the name.
SongReading ReadSong(ByteSource& source, const QString& path, const ReadOptions& options);
