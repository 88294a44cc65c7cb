#pragma once

#include <QString>
#include <QStringList>

struct SongGenerator {
    int Songs = 10'000;
    int Artists = 0;  // 0: one for sixty songs
    // Every second song has a picture of this size, every second an ID3v2.4 tag and every third a variable
    // bit rate.
    std::size_t CoverBytes = 50'000;

    // Writes FOLDER/Artist/Year - Album/Artist - Title (Number).mp3, twelve songs an album, and returns the
    // paths. The files are as WriteSongFile makes them: 100 KB to 1 MB, sparse. Throws EStreamError.
    QStringList Write(const QString& folder) const;
};
