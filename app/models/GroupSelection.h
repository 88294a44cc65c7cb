#pragma once

#include <QSet>
#include <QString>
#include <bitset>

#include "MusicManagment/database/SongTypes.h"
#include "ReadMPEGHeader/Genres.h"
#include "ReadMPEGHeader/ID3Tag.h"

// Groups of songs that the user has chosen in the overview.
struct GroupSelection {
    TOVType Type = ovArtist;
    QSet<QString> Captions{};               // of the groups; of every type but the genres
    std::bitset<kMainGenreCount> Genres{};  // rows of the genres, when these are the type

    // Nothing is chosen: the song list is not narrowed.
    bool IsEmpty() const { return Type == ovGenre ? Genres.none() : Captions.isEmpty(); }
    // True when the song is in one of the groups, or nothing is chosen.
    bool Matches(const TID3Tag& song) const;

    bool operator==(const GroupSelection&) const = default;
};
