#include "MusicManagment/database/PackedRecord.h"

#include <algorithm>
#include <limits>

#include "MusicManagment/database/GroupLists.h"

namespace {

quint16 StoredYear(const QString& year) {
    constexpr int kHighest = std::numeric_limits<quint16>::max();
    return static_cast<quint16>(std::clamp(YearNumber(year), 0, kHighest));
}

}  // namespace

quint16 ReadPackedRecord(ByteReader& stream, TID3Tag& song) {
    const quint16 year = stream.U16Le();
    song.Length = stream.U16Le();
    song.Genre = stream.U8();
    song.BitRate = stream.U16Le();
    song.SampleRate = stream.U16Le();
    song.ChannelMode = stream.U8();
    song.Emphasis = stream.U8();
    song.Private = stream.U8() != 0;
    song.Protected = stream.U8() != 0;
    song.Copyrighted = stream.U8() != 0;
    song.Original = stream.U8() != 0;
    song.Padding = stream.U8() != 0;
    song.FrameSize = stream.U16Le();
    song.Track = stream.U8();
    song.PlayCount = stream.U32Le();
    song.Reserved = stream.U16Le();
    song.Flags = stream.U32Le();
    song.MainGenre = stream.U8();
    song.Remix = stream.U8() != 0;
    song.AddTime = stream.F64Le();
    return year;
}

void WritePackedRecord(ByteWriter& stream, const TID3Tag& song) {
    stream.U16Le(StoredYear(song.Year));
    stream.U16Le(song.Length);
    stream.U8(song.Genre);
    stream.U16Le(song.BitRate);
    stream.U16Le(song.SampleRate);
    stream.U8(song.ChannelMode);
    stream.U8(song.Emphasis);
    stream.U8(song.Private ? 1 : 0);
    stream.U8(song.Protected ? 1 : 0);
    stream.U8(song.Copyrighted ? 1 : 0);
    stream.U8(song.Original ? 1 : 0);
    stream.U8(song.Padding ? 1 : 0);
    stream.U16Le(song.FrameSize);
    stream.U8(song.Track);
    stream.U32Le(song.PlayCount);
    stream.U16Le(song.Reserved);
    stream.U32Le(song.Flags);
    stream.U8(song.MainGenre);
    stream.U8(song.Remix ? 1 : 0);
    stream.F64Le(song.AddTime);
}
