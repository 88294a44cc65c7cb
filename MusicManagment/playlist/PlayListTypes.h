#pragma once

#include <QString>
#include <optional>

#include "CommonRUKTools/Errors.h"
#include "ReadMPEGHeader/ID3Tag.h"

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
    std::optional<TID3Tag> Record{};

    bool operator==(const PlayListEntry&) const = default;
};
