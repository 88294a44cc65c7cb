#pragma once

#include <QHash>
#include <QString>

#include "CommonRUKTools/Listeners.h"
#include "MusicManagment/database/SongTypes.h"
#include "ReadMPEGHeader/ID3Tag.h"

// Old path to new path, of songs that change their paths at the same time: two of them may swap theirs.
using PathChanges = QHash<QString, QString>;

// What happens to a collection, told once to everybody who has subscribed. A song that is given another place
// by a change or an insertion is told of when it stands there. Listeners must not throw.
struct CollectionEvents {
    // The place of the new song.
    Listeners<SongIndex> Inserted;
    // The record at this place, as it was and as it is. Comes after Moved, when the song has another place
    // now.
    Listeners<SongIndex, const TID3Tag&, const TID3Tag&> Changed;
    // A song has taken another place: from, to (counted after it was taken out).
    Listeners<SongIndex, SongIndex> Moved;
    // Where the song stood, and its record.
    Listeners<SongIndex, const TID3Tag&> Removed;
    // Songs have other paths now. Comes after Changed, once for all that changed together.
    Listeners<const PathChanges&> Renamed;
    // Songs have gone, and others stand for them: old path to that of the other. Comes after Removed.
    Listeners<const PathChanges&> Superseded;
    // Around a new order of the same songs.
    Listeners<> Reordering;
    Listeners<> Reordered;
    // Any songs may be there now, in any places.
    Listeners<> Replaced;
    // No songs are there any more; another collection begins.
    Listeners<> Cleared;
    // So many songs are about to come from a file.
    Listeners<int> Reserve;
    // The ban list has other entries; told once a command, which has not ended yet.
    Listeners<> BannListChanged;
    // A medium has come or gone: songs look different, none has changed.
    Listeners<> MediaChanged;
    Listeners<> ModifiedChanged;
    Listeners<> ReadOnlyChanged;
};
