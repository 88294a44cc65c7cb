#pragma once

#include <QString>
#include <QStringList>
#include <cstdint>

struct SongGenerator {
    int Songs = 10'000;
    int Artists = 0;  // 0: one for sixty songs
    // Every second song has a picture of this size, every second an ID3v2.4 tag and every third a variable
    // bit rate.
    std::size_t CoverBytes = 50'000;
    std::int64_t AudioBytes = 0;  // about, of each song, all of them written; 0: 100 KB to 1 MB with a hole

    // Writes FOLDER/Artist/Year - Album/Artist - Title (Number).mp3, twelve songs an album, and returns the
    // paths. The files are as WriteSongFile makes them. Throws EStreamError.
    QStringList Write(const QString& folder) const;
};
