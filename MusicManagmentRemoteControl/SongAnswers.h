#pragma once

#include <QByteArray>
#include <QString>
#include <optional>

class TMusicDatabase;
class TPlaySound;

// What is sent to a window that has asked for a song.
struct SongAnswer {
    quint32 Code;  // the number of the message, higher by kUtf8Code for a text in UTF-8
    QByteArray Bytes;
};

// The song's packed record (rmSongRecord) or one of its texts (rmSongFileName to rmSongComment), as `window`
// wants it. `index` is a position in the collection, or -1 for the song that plays. Nothing when there is no
// such song.
std::optional<SongAnswer> AnswerAboutSong(const TMusicDatabase& database, const TPlaySound* player,
                                          quint32 message, qint32 index, quint32 window);

// In the encoding that the window wants.
QByteArray EncodeForWindow(const QString& text, quint32 window);
