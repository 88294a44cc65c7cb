#pragma once

#include <QString>
#include <optional>

#include "CommonRUKTools/FileSource.h"
#include "ReadMPEGHeader/ID3Tag.h"

// What the header of a WMA (ASF) file tells: Advanced Systems Format (ASF), revision 01.20.03.
struct TASFInfo {
    QString Title;
    QString Artist;
    QString Album;
    QString Year;
    QString Comment;
    QString CodecName;
    QString CodecDescription;
    quint8 Genre = 255;  // where an attribute gives one that the genre table has
    quint8 Track = 0;
    quint64 PlayDuration = 0;  // 100-ns units, includes the preroll
    quint64 Preroll = 0;       // milliseconds
    quint64 CreationTime = 0;  // 100-ns units since 1 January 1601 UTC
    quint32 BitRate = 0;       // bit/s
    quint32 SampleRate = 0;    // Hz
    quint16 Channels = 0;
    quint16 BlockAlign = 0;  // bytes
    bool Encrypted = false;
};

enum class AsfLength {
    AsStored,     // play duration as it stands in the header
    LessPreroll,  // what is heard
};

// True when `head` begins with the ASF header object's identifier.
bool IsAsf(ByteSpan head);
// Nothing when the header is damaged beyond use. Throws EStreamError when the medium fails.
std::optional<TASFInfo> ReadAsfHeader(ByteSource& stream);
// The record of a WMA file.
TID3Tag TagFromAsf(const TASFInfo& info, AsfLength length);
