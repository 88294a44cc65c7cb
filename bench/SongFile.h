#pragma once

#include <QString>
#include <cstdint>

// What a generated MP3 file holds.
struct SongFile {
    QString Title;
    QString Artist;
    QString Album;
    int Year = 2000;
    int Track = 1;
    int Genre = 17;
    int TagVersion = 3;           // ID3v2.3 with UTF-16 texts, or ID3v2.4 with UTF-8 texts
    std::size_t CoverBytes = 0;   // size of the picture, 0 none
    bool Vbr = false;             // frames of many sizes and a Xing header, else 128 kbit/s
    std::int64_t AudioBytes = 0;  // about
    bool HasHole = true;          // where readers of headers and tags never look
};

// Writes ID3v2 tag, MPEG 1 Layer III frames at 44100 Hz and ID3v1 tag. With a hole only the first and the
// last frames are written, so that a collection of any size fits on the disk. Throws EStreamError.
void WriteSongFile(const QString& path, const SongFile& song);
