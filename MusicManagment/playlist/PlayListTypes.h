#pragma once

#include <QString>

#include "CommonRUKTools/Errors.h"
#include "MusicManagment/playlist/ListedRecord.h"

class EPlayListException : public ERukException {
 public:
    using ERukException::ERukException;
};

// Which song follows.
enum TPlayOrder { poDownwards, poUpwards, poRandom, poStopAfterPlay };

// How the player goes from one song to the next.
enum class SongChange {
    Hard,           // at once
    CrossFade,      // by a cross-fade; at once where that is not possible
    CrossFadeOnly,  // by a cross-fade; where that is not possible the current song goes on
};

// One line of a playlist.
struct PlayListEntry {
    QString Name;  // path, stored CD path or address (http), as it is listed
    ListedRecord Record{};

    bool operator==(const PlayListEntry&) const = default;
};

// An entry itself, wherever it stands and however often its song is listed. Never used again; 0 is none.
using EntryId = quint64;

// An entry that is remembered. When it has left the list the first with its name stands in for it.
struct RememberedEntry {
    EntryId Id = 0;
    QString Name{};
};
