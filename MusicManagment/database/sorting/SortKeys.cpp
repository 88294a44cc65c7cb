#include "MusicManagment/database/sorting/SortKeys.h"

#include <algorithm>
#include <bit>
#include <cmath>

#include "MusicManagment/database/GroupLists.h"

namespace {

// A song on a catalogued CD is there (1) or not (2); any other song needs no medium (0).
int CacheKind(const SongOrder& order, const TID3Tag& song) {
    if (!IsCdPath(song.FileName)) return 0;
    const quint32 serial = SerialOfCdPath(song.FileName);
    return serial != 0 && std::ranges::binary_search(order.MediaThere, serial) ? 1 : 2;
}

quint32 CountedFlags(const SongOrder& order, quint32 flags) {
    return order.ShownFlag != 0 ? flags & order.ShownFlag : flags;
}

// Maps a double to a number of the same order. A value that is none ranks as 0.
quint64 OrderedBits(double value) {
    if (std::isnan(value) || value == 0) value = 0;
    const auto bits = std::bit_cast<quint64>(value);
    constexpr quint64 kSign = quint64{1} << 63;
    return (bits & kSign) != 0 ? ~bits : bits | kSign;
}

}  // namespace

const QString* PrimaryText(TSortType type, const TID3Tag& song) {
    switch (type) {
        case stTitle:
            return &song.Title;
        case stArtist:
            return &song.Artist;
        case stAlbum:
            return &song.Album;
        case stComment:
            return &song.Comment;
        case stPath:
            return &song.FileName;
        default:
            return nullptr;
    }
}

quint64 PrimaryNumber(const SongOrder& order, const TID3Tag& song) {
    switch (order.SortType) {
        case stYear:
            return static_cast<quint64>(YearNumber(song.Year) + (qint64{1} << 32));
        case stLength:
            return song.Length;
        case stGenre:
            return song.MainGenre;
        case stPlayCnt:
            return song.PlayCount;
        case stAddTime:
            return OrderedBits(song.AddTime);
        case stFlags:
            return CountedFlags(order, song.Flags);
        default:
            return static_cast<quint64>(CacheKind(order, song));
    }
}
