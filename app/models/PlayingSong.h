#pragma once

#include <QString>

class TPlayList;
class TPlaySound;

// What is shown of a song that plays or will.
struct PlayingSong {
    QString FileName{};  // as it is listed; empty: no song
    QString Title{};     // the file's name when nothing else is known
    QString Artist{};
    QString Album{};
    int Track = 0;         // 0 unknown
    qint64 PlayCount = 0;  // as the collection counts it
    qint64 Seconds = 0;    // as the record tells; 0 unknown

    bool operator==(const PlayingSong&) const = default;
};

// The song of this name, as list and collection know it.
PlayingSong SongNamed(const QString& name, const TPlayList& list);
// The song that the player has. What it plays can be a copy of what is listed.
PlayingSong SongOf(const TPlaySound& player, const TPlayList& list);

// "Artist - Titel"
QString OneLine(const PlayingSong& song);
