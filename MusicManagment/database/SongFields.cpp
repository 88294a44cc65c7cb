#include "MusicManagment/database/SongFields.h"

#include <QLocale>
#include <algorithm>

#include "CommonRUKTools/Clock.h"
#include "MusicManagment/database/GroupLists.h"
#include "ReadMPEGHeader/DisplayTexts.h"
#include "ReadMPEGHeader/Genres.h"

using namespace Qt::StringLiterals;

namespace {

using Song = const TID3Tag&;

QString YearText(Song song) {
    const bool onlyZeros = std::ranges::all_of(song.Year, [](QChar c) { return c == u'0'; });
    return onlyZeros ? QString() : song.Year;
}

QString GenreText(Song song) {
    if (song.Genre == kNoGenre && !song.Remix) return {};
    return GenreName(song.Genre) + (song.Remix ? u" (Remix)"_s : QString());
}

QString TrackText(Song song) {
    return song.Track != 0 ? QString::number(song.Track) : QString();
}

QString ChannelsText(Song song) {
    return song.ChannelMode != 0 ? FormatChannelMode(song.ChannelMode) : QString();
}

QString AddTimeText(Song song) {
    if (song.AddTime <= 0) return {};
    return FromDayCount(song.AddTime).toString(u"dd.MM.yyyy hh:mm"_s);
}

QString FlagsText(Song song) {
    constexpr quint32 kNamed = sfBurned | sfDamaged | sfLengthCorrect | sfRemixed;
    return (song.Flags & kNamed) != 0 ? FormatSongFlags(song.Flags) : QString();
}

QString FrameSizeText(Song song) {
    if (song.FrameSize == 0) return {};
    return QLocale(QLocale::German).toString(song.FrameSize) + u" Bytes"_s;
}

template <auto Member>
QString TextOf(Song song) {
    return song.*Member;
}

template <auto Member>
qint64 NumberOf(Song song) {
    return song.*Member;
}

using Id = SongFieldId;
using Group = FieldGroup;

constexpr SongField kFields[] = {
    {.Id = Id::Title,
     .Caption = u"Titel",
     .ShortCaption = u"Titel",
     .Group = Group::Tag,
     .Text = &TextOf<&TID3Tag::Title>,
     .Sort = stTitle,
     .FilterNames = u"titel title",
     .InPlainSearch = true,
     .Editable = true,
     .FormName = "title"},
    {.Id = Id::Artist,
     .Caption = u"Artist",
     .ShortCaption = u"Artist",
     .Group = Group::Tag,
     .Text = &TextOf<&TID3Tag::Artist>,
     .Sort = stArtist,
     .FilterNames = u"artist interpret",
     .InPlainSearch = true,
     .Editable = true,
     .FormName = "artist"},
    {.Id = Id::Album,
     .Caption = u"Album",
     .ShortCaption = u"Album",
     .Group = Group::Tag,
     .Text = &TextOf<&TID3Tag::Album>,
     .Sort = stAlbum,
     .FilterNames = u"album",
     .InPlainSearch = true,
     .Editable = true,
     .FormName = "album"},
    {.Id = Id::Year,
     .Caption = u"Jahr",
     .ShortCaption = u"Jahr",
     .Group = Group::Tag,
     .Text = &YearText,
     .Number = [](Song song) -> qint64 { return YearNumber(song.Year); },
     .Sort = stYear,
     .FilterNames = u"jahr year",
     .InPlainSearch = true,
     .Editable = true,
     .FormName = "year"},
    {.Id = Id::Length,
     .Caption = u"Länge",
     .ShortCaption = u"Länge",
     .Group = Group::Technical,
     .Text = [](Song song) { return FormatLength(song.Length, true); },
     .Number = &NumberOf<&TID3Tag::Length>,
     .Sort = stLength,
     .FilterNames = u"länge length laenge"},
    {.Id = Id::MainGenre,
     .Caption = u"Hauptgenre",
     .ShortCaption = u"Genre",
     .Group = Group::Collection,
     .Text = &GenreDisplayText,
     .Sort = stGenre,
     .FilterNames = u"genre",
     .Editable = true,
     .FormName = "mainGenre"},
    {.Id = Id::Genre,
     .Caption = u"Genre",
     .ShortCaption = u"ID3-Genre",
     .Group = Group::Tag,
     .Text = &GenreText,
     .FilterNames = u"id3genre",
     .Editable = true,
     .FormName = "genre"},
    {.Id = Id::Track,
     .Caption = u"Track",
     .ShortCaption = u"Track",
     .Group = Group::Tag,
     .Text = &TrackText,
     .Number = &NumberOf<&TID3Tag::Track>,
     .FilterNames = u"track",
     .Editable = true,
     .FormName = "track"},
    {.Id = Id::BitRate,
     .Caption = u"Bitrate",
     .ShortCaption = u"Bitrate",
     .Group = Group::Technical,
     .Text = [](Song song) { return FormatBitRate(song.BitRate); },
     .Number = &NumberOf<&TID3Tag::BitRate>,
     .FilterNames = u"bitrate"},
    {.Id = Id::SampleRate,
     .Caption = u"Abtastrate",
     .ShortCaption = u"Abtastrate",
     .Group = Group::Technical,
     .Text = [](Song song) { return FormatSampleRate(song.SampleRate); },
     .Number = &NumberOf<&TID3Tag::SampleRate>,
     .FilterNames = u"abtastrate samplerate"},
    {.Id = Id::Channels,
     .Caption = u"Kanäle",
     .ShortCaption = u"Kanäle",
     .Group = Group::Technical,
     .Text = &ChannelsText},
    {.Id = Id::Format,
     .Caption = u"Format",
     .ShortCaption = u"Format",
     .Group = Group::Technical,
     .Text = &TextOf<&TID3Tag::MPEGLayer>,
     .FilterNames = u"format"},
    {.Id = Id::PlayCount,
     .Caption = u"Beliebtheit",
     .ShortCaption = u"Beliebtheit",
     .Group = Group::Collection,
     .Text = [](Song song) { return QString::number(song.PlayCount); },
     .Number = &NumberOf<&TID3Tag::PlayCount>,
     .Sort = stPlayCnt,
     .FilterNames = u"beliebtheit playcount"},
    {.Id = Id::Comment,
     .Caption = u"Kommentar",
     .ShortCaption = u"Kommentar",
     .Group = Group::Tag,
     .Text = &TextOf<&TID3Tag::Comment>,
     .Sort = stComment,
     .FilterNames = u"kommentar comment",
     .InPlainSearch = true,
     .Editable = true,
     .FormName = "comment"},
    {.Id = Id::AddTime,
     .Caption = u"Hinzugefügt am",
     .ShortCaption = u"Datum",
     .Group = Group::Collection,
     .Text = &AddTimeText,
     .Sort = stAddTime},
    {.Id = Id::Flags,
     .Caption = u"Flags",
     .ShortCaption = u"Flags",
     .Group = Group::Collection,
     .Text = &FlagsText,
     .Sort = stFlags,
     .FilterNames = u"flag"},
    {.Id = Id::Path,
     .Caption = u"Pfad",
     .ShortCaption = u"Pfad",
     .Group = Group::File,
     .Text = &TextOf<&TID3Tag::FileName>,
     .Sort = stPath,
     .FilterNames = u"pfad path",
     .InPlainSearch = true},
    {.Id = Id::Emphasis,
     .Caption = u"Emphasis",
     .ShortCaption = u"Emphasis",
     .Group = Group::Technical,
     .Text = [](Song song) { return FormatEmphasis(song.Emphasis); }},
    {.Id = Id::HeaderFlags,
     .Caption = u"Kennzeichen",
     .ShortCaption = u"Kennzeichen",
     .Group = Group::Technical,
     .Text = &FormatHeaderFlags},
    {.Id = Id::FrameSize,
     .Caption = u"Framegröße",
     .ShortCaption = u"Framegröße",
     .Group = Group::Technical,
     .Text = &FrameSizeText},
};

constexpr RecordMember kMembers[] = {
    {"fileName", &TID3Tag::FileName},
    {"title", &TID3Tag::Title},
    {"artist", &TID3Tag::Artist},
    {"album", &TID3Tag::Album},
    {"year", &TID3Tag::Year},
    {"comment", &TID3Tag::Comment},
    {"format", &TID3Tag::MPEGLayer},
    {"length", &TID3Tag::Length},
    {"genre", &TID3Tag::Genre},
    {"bitRate", &TID3Tag::BitRate},
    {"sampleRate", &TID3Tag::SampleRate},
    {"channelMode", &TID3Tag::ChannelMode},
    {"emphasis", &TID3Tag::Emphasis},
    {"private", &TID3Tag::Private},
    {"protected", &TID3Tag::Protected},
    {"copyrighted", &TID3Tag::Copyrighted},
    {"original", &TID3Tag::Original},
    {"padding", &TID3Tag::Padding},
    {"frameSize", &TID3Tag::FrameSize},
    {"track", &TID3Tag::Track},
    {"playCount", &TID3Tag::PlayCount},
    {"reserved", &TID3Tag::Reserved},
    {"flags", &TID3Tag::Flags},
    {"mainGenre", &TID3Tag::MainGenre},
    {"remix", &TID3Tag::Remix},
    {"fileTime", &TID3Tag::AddTime},
};

}  // namespace

std::span<const SongField> SongFields() {
    return kFields;
}

const SongField& FieldOf(SongFieldId id) {
    return kFields[static_cast<std::size_t>(id)];
}

QString SearchedText(const SongField& field, const TID3Tag& song) {
    if (field.Id != SongFieldId::MainGenre || song.Genre == kNoGenre) return field.Text(song);
    return MainGenreLongName(song.MainGenre) + u'\n' + GenreName(song.Genre);
}

std::span<const RecordMember> RecordMembers() {
    return kMembers;
}
