#include "app/models/SongColumns.h"

#include <QLocale>
#include <algorithm>

#include "CommonRUKTools/Clock.h"
#include "MusicManagment/database/GroupLists.h"
#include "ReadMPEGHeader/DisplayTexts.h"
#include "ReadMPEGHeader/Genres.h"
#include "app/models/SongProperties.h"

using namespace Qt::StringLiterals;

namespace {

QString Title(const TID3Tag& song) {
    return IsCdPath(song.FileName) ? u"[CD] "_s + song.Title : song.Title;
}

QString AddTime(const TID3Tag& song) {
    return FromDayCount(song.AddTime).toString(u"dd.MM.yyyy hh:mm"_s);
}

QString Id3Genre(const TID3Tag& song) {
    return song.Genre != kNoGenre ? GenreName(song.Genre) : QString();
}

QString Channels(const TID3Tag& song) {
    return song.ChannelMode != 0 ? FormatChannelMode(song.ChannelMode) : QString();
}

QString Flags(const TID3Tag& song) {
    constexpr quint32 kNamed = sfBurned | sfDamaged | sfLengthCorrect | sfRemixed;
    return (song.Flags & kNamed) != 0 ? FormatSongFlags(song.Flags) : QString();
}

constexpr SongColumn kColumns[] = {
    {SongColumnId::Title, u"Titel", 34, Qt::AlignLeft, true, stTitle, &Title},
    {SongColumnId::Artist, u"Artist", 24, Qt::AlignLeft, true, stArtist,
     [](const TID3Tag& song) { return song.Artist; }},
    {SongColumnId::Album, u"Album", 24, Qt::AlignLeft, true, stAlbum,
     [](const TID3Tag& song) { return song.Album; }},
    {SongColumnId::Year, u"Jahr", 7, Qt::AlignRight, true, stYear, &ShownYear},
    {SongColumnId::Length, u"Länge", 9, Qt::AlignRight, true, stLength,
     [](const TID3Tag& song) { return FormatLength(song.Length, true); }},
    {SongColumnId::Genre, u"Genre", 18, Qt::AlignLeft, true, stGenre,
     [](const TID3Tag& song) { return MainGenreLongName(song.MainGenre); }},
    {SongColumnId::Id3Genre, u"ID3-Genre", 18, Qt::AlignLeft, false, std::nullopt, &Id3Genre},
    {SongColumnId::Track, u"Track", 7, Qt::AlignRight, true, std::nullopt, &ShownTrack},
    {SongColumnId::BitRate, u"Bitrate", 14, Qt::AlignRight, true, std::nullopt,
     [](const TID3Tag& song) { return FormatBitRate(song.BitRate); }},
    {SongColumnId::SampleRate, u"Abtastrate", 12, Qt::AlignRight, true, std::nullopt,
     [](const TID3Tag& song) { return FormatSampleRate(song.SampleRate); }},
    {SongColumnId::Channels, u"Kanäle", 12, Qt::AlignLeft, false, std::nullopt, &Channels},
    {SongColumnId::Format, u"Format", 25, Qt::AlignLeft, true, std::nullopt,
     [](const TID3Tag& song) { return song.MPEGLayer; }},
    {SongColumnId::PlayCount, u"Beliebtheit", 11, Qt::AlignRight, true, stPlayCnt,
     [](const TID3Tag& song) { return QString::number(song.PlayCount); }},
    {SongColumnId::Comment, u"Kommentar", 20, Qt::AlignLeft, true, stComment,
     [](const TID3Tag& song) { return song.Comment; }},
    {SongColumnId::AddTime, u"Datum", 17, Qt::AlignLeft, true, stAddTime, &AddTime},
    {SongColumnId::Flags, u"Flags", 20, Qt::AlignLeft, true, stFlags, &Flags},
    {SongColumnId::Path, u"Pfad", 50, Qt::AlignLeft, true, stPath,
     [](const TID3Tag& song) { return song.FileName; }},
};

}  // namespace

std::span<const SongColumn> SongColumns() {
    return kColumns;
}

int ColumnOfSortType(TSortType type) {
    const auto found = std::ranges::find(kColumns, std::optional(type), &SongColumn::Sort);
    return found != std::end(kColumns) ? static_cast<int>(found - std::begin(kColumns)) : -1;
}
