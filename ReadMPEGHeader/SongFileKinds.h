#pragma once

#include <QString>
#include <QStringView>
#include <span>

// What a file's extension says of it. The only list of the extensions that make a file a song.

struct SongFileKind {
    QStringView Extension;    // with its dot, in lower case
    QStringView Description;  // format text where the file itself tells nothing; empty: none
    bool IsCollected;         // the collection takes such files in
    bool IsOpened;            // such a file given to the program is a song to play
};

// In the order in which dialogs name them.
std::span<const SongFileKind> SongFileKinds();
// The kind of a name, its extension in any case; nullptr when the table has none.
const SongFileKind* KindOfSongFile(const QString& path);

// ".mp3;.mp2;.wma;.wav;": the extensions of what the collection takes in.
QString AcceptedExtensions();
// True for a name that the collection takes in.
bool IsSongFile(const QString& path);
