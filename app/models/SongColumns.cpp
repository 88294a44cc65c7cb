#include "app/models/SongColumns.h"

#include <QLocale>
#include <algorithm>

#include "CommonRUKTools/Clock.h"
#include "MusicManagment/database/GroupLists.h"
#include "ReadMPEGHeader/DisplayTexts.h"
#include "ReadMPEGHeader/Genres.h"

using namespace Qt::StringLiterals;

namespace {

QString Title(const TID3Tag& song) {
    return IsCdPath(song.FileName) ? u"[CD] "_s + song.Title : song.Title;
}

// A year that was not there is stored as "0000", and read from a database as "0".
QString Year(const TID3Tag& song) {
    const bool onlyZeros = std::ranges::all_of(song.Year, [](QChar c) { return c == u'0'; });
    return onlyZeros ? QString() : song.Year;
}

QString Track(const TID3Tag& song) {
    return song.Track != 0 ? QString::number(song.Track) : QString();
}

QString AddTime(const TID3Tag& song) {
    return FromDayCount(song.AddTime).toString(u"dd.MM.yyyy hh:mm"_s);
}

constexpr SongColumn kColumns[] = {
    {SongColumnId::Title, u"Titel", 34, Qt::AlignLeft, stTitle, &Title},
    {SongColumnId::Artist, u"Artist", 24, Qt::AlignLeft, stArtist,
     [](const TID3Tag& song) { return song.Artist; }},
    {SongColumnId::Album, u"Album", 24, Qt::AlignLeft, stAlbum,
     [](const TID3Tag& song) { return song.Album; }},
    {SongColumnId::Year, u"Jahr", 7, Qt::AlignRight, stYear, &Year},
    {SongColumnId::Length, u"Länge", 9, Qt::AlignRight, stLength,
     [](const TID3Tag& song) { return FormatLength(song.Length, true); }},
    {SongColumnId::Genre, u"Genre", 18, Qt::AlignLeft, stGenre,
     [](const TID3Tag& song) { return MainGenreLongName(song.MainGenre); }},
    {SongColumnId::Track, u"Track", 7, Qt::AlignRight, std::nullopt, &Track},
    {SongColumnId::BitRate, u"Bitrate", 14, Qt::AlignRight, std::nullopt,
     [](const TID3Tag& song) { return FormatBitRate(song.BitRate); }},
    {SongColumnId::SampleRate, u"Abtastrate", 12, Qt::AlignRight, std::nullopt,
     [](const TID3Tag& song) { return FormatSampleRate(song.SampleRate); }},
    {SongColumnId::Format, u"Format", 25, Qt::AlignLeft, std::nullopt,
     [](const TID3Tag& song) { return song.MPEGLayer; }},
    {SongColumnId::PlayCount, u"Beliebtheit", 11, Qt::AlignRight, stPlayCnt,
     [](const TID3Tag& song) { return QString::number(song.PlayCount); }},
    {SongColumnId::Comment, u"Kommentar", 20, Qt::AlignLeft, stComment,
     [](const TID3Tag& song) { return song.Comment; }},
    {SongColumnId::AddTime, u"Datum", 17, Qt::AlignLeft, stAddTime, &AddTime},
    {SongColumnId::Path, u"Pfad", 50, Qt::AlignLeft, stPath,
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
