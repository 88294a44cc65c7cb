#pragma once

#include "MusicManagment/database/MusicManagment.h"

// A song on a CD that is not in the drive: it needs no file.
inline TID3Tag CdSong(const QString& title, int seconds = 60) {
    TID3Tag song;
    song.FileName = QStringLiteral(":00000001:\\") + title + QStringLiteral(".mp3");
    song.Title = title;
    song.Length = static_cast<quint16>(seconds);
    return song;
}

inline SongIndex AddSong(TMusicDatabase& database, const QString& title, int seconds = 60) {
    return database.AddEntry(QString(), CdSong(title, seconds));
}
