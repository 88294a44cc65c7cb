#include "MusicManagment/database/tsdb/PackedRecord.h"

#include <algorithm>
#include <bit>
#include <limits>

#include "MusicManagment/database/GroupLists.h"

namespace {

quint16 StoredYear(const QString& year) {
    constexpr int kHighest = std::numeric_limits<quint16>::max();
    return static_cast<quint16>(std::clamp(YearNumber(year), 0, kHighest));
}

// The record in the making. Its fixed size lets the compiler store each field at once, which a growing buffer
// does not.
class Record {
 public:
    template <typename T>
    void Put(T value) {
        for (std::size_t i = 0; i < sizeof(T); ++i)
            bytes_[size_++] = static_cast<std::uint8_t>(value >> (8 * i));
    }
    void Put(bool value) { Put(static_cast<quint8>(value ? 1 : 0)); }
    void Put(double value) { Put(std::bit_cast<quint64>(value)); }
    const std::array<std::uint8_t, kPackedRecordSize>& Bytes() const { return bytes_; }

 private:
    std::array<std::uint8_t, kPackedRecordSize> bytes_{};
    std::size_t size_ = 0;
};

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

std::array<std::uint8_t, kPackedRecordSize> PackedRecord(const TID3Tag& song) {
    Record record;
    record.Put(StoredYear(song.Year));
    record.Put(song.Length);
    record.Put(song.Genre);
    record.Put(song.BitRate);
    record.Put(song.SampleRate);
    record.Put(song.ChannelMode);
    record.Put(song.Emphasis);
    record.Put(song.Private);
    record.Put(song.Protected);
    record.Put(song.Copyrighted);
    record.Put(song.Original);
    record.Put(song.Padding);
    record.Put(song.FrameSize);
    record.Put(song.Track);
    record.Put(song.PlayCount);
    record.Put(song.Reserved);
    record.Put(song.Flags);
    record.Put(song.MainGenre);
    record.Put(song.Remix);
    record.Put(song.AddTime);
    return record.Bytes();
}
