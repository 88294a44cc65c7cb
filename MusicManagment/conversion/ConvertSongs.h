#pragma once

#include "MusicManagment/conversion/EncoderSettings.h"
#include "MusicManagment/database/batches/BatchSongs.h"
#include "MusicManagment/database/batches/MediaCopies.h"

// Songs of the collection become files of another format, by its encoder settings.

enum class ConversionPlace : quint8 {
    Beside,   // in the folder of the source
    Folder,   // in one that is named
    InPlace,  // the song has the new file then, and the old one lies in the recycle bin
};

struct ConversionOrder {
    MusicFormat Format = MusicFormat::Mp3;
    ConversionPlace Place = ConversionPlace::Beside;
    QString Folder{};
};

struct ConversionResult : MediaBatchResult {
    int Replaced = 0;  // of those done, songs that have the new file now
};

// A long operation. Beside and in the folder the new files are no songs of the collection. A song on a medium
// gets a copy on the disk, as caching would make it, where it is not to go into a folder; the song then plays
// from there. In place is one step that can be taken back: the songs keep what the collection knows of them,
// and are renamed by the settings. A song that fails stays as it is and does not stop the others. Throws
// EAbort, after telling the user, when another operation runs.
ConversionResult ConvertSongs(TMusicDatabase& database, const BatchSongs& songs,
                              const ConversionOrder& order);
