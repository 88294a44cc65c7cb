#pragma once

#include <QString>

class TPlayList;
class TPlaySound;

// What is shown of the song that plays.
struct PlayingSong {
    QString FileName{};  // as it is listed; empty: no song
    QString Title{};     // the file's name when nothing else is known
    QString Artist{};
    QString Album{};
    int Track = 0;  // 0 unknown

    bool operator==(const PlayingSong&) const = default;
};

// The song that the player has. What it plays can be a copy of what is listed.
PlayingSong SongOf(const TPlaySound& player, const TPlayList& list);

// "Artist - Titel"
QString OneLine(const PlayingSong& song);
