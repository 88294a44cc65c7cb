#pragma once

#include <QString>
#include <QtGlobal>

// One audio file's tags and technical data. The texts are reference-counted; a copy shares them.
struct TID3Tag {
    QString FileName;  // path or name that the record belongs to
    QString Title;
    QString Artist;
    QString Album;
    QString Year;  // as text; four characters when valid, "0000" when nothing was read
    QString Comment;
    QString MPEGLayer;  // description of the coding: "MPEG 1.0 Layer III", "Wave", ...

    quint16 Length = 0;      // seconds
    quint8 Genre = 255;      // ID3v1 genre number; 255 none
    quint16 BitRate = 0;     // kbit/s
    quint16 SampleRate = 0;  // Hz
    quint8 ChannelMode =
        0;  // 1 mono, 2 stereo, 3 joint stereo, 4 two channels, 5 four, 6 six, 7 eight; 0 unknown
    quint8 Emphasis = 0;     // 1 none, 2 reserved, 3 50/15 µs, 4 CCITT J.17; 0 unknown
    bool Private = false;    // private bit of the MPEG header; for WMA: the stream is encrypted
    bool Protected = false;  // the MPEG frames carry a CRC
    bool Copyrighted = false;
    bool Original = false;
    bool Padding = false;   // padding bit of the first frame
    quint16 FrameSize = 0;  // bytes of one frame; block alignment for WAV and WMA
    quint8 Track = 0;       // 0 none
    quint32 PlayCount = 0;
    quint16 Reserved = 0;  // kept as it is; 65535 means not set in stored records
    quint32 Flags = 0;     // song flags of the collection
    quint8 MainGenre = 0;  // 0 to 19; 0 unknown
    bool Remix = false;    // the genre carries the mark "(RX)"
    double AddTime = 0;    // the file time: days since 30 December 1899, fraction = time of day

    bool operator==(const TID3Tag&) const = default;
};

// Sets the defaults: texts empty, year "0000", format "MPEG ??? Layer ???", genre 255, numbers 0, the given
// file time. With `keep` all texts are empty, year and format too, and the file time is 0.
void ResetTag(bool keep, TID3Tag& tag, double fileTime);

enum class MergeMode {
    Tags = 0,  // title, artist, album, year, comment, genre, track; the file name where the target's is empty
    FillEmpty = 1,  // also format, length and play count, each where the target's is empty or zero
    Technical = 2,  // also format, length and every number behind the genre, unconditionally
};

void MergeTag(TID3Tag& target, const TID3Tag& source, MergeMode mode);

// Sets the format text from the extension; an unknown extension leaves it as it is.
void DescribeByExtension(const QString& path, TID3Tag& tag);
