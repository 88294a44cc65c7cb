#include "MusicManagment/database/SongFields.h"

#include <QLocale>
#include <algorithm>
#include <limits>
#include <type_traits>

#include "CommonRUKTools/Clock.h"
#include "MusicManagment/database/GroupLists.h"
#include "ReadMPEGHeader/DerivedGenre.h"
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

// --- Editing ---

QString GenreEdited(Song song) {
    if (song.Genre == kNoGenre) return {};
    const QString name = GenreName(song.Genre);
    return GenreByName(name) == song.Genre ? name : QString::number(song.Genre);
}

QString MainGenreEdited(Song song) {
    return MainGenreLongName(song.MainGenre);
}

QString RemixText(Song song) {
    return song.Remix ? u"ja"_s : u"nein"_s;
}

QString FlagsEdited(Song song) {
    const QStringList names = SongFlagNames();
    QStringList set;
    for (qsizetype i = 0; i < names.size(); ++i)
        if ((song.Flags & (1U << i)) != 0) set << names[i];
    return set.join(u", "_s);
}

template <auto Member>
bool SetText(TID3Tag& song, const QString& text) {
    song.*Member = text;
    return true;
}

// No text is the number 0.
template <auto Member>
bool SetNumber(TID3Tag& song, const QString& text) {
    using Value = std::remove_reference_t<decltype(song.*Member)>;
    bool isNumber = true;
    const QString trimmed = text.trimmed();
    const qulonglong number = trimmed.isEmpty() ? 0 : trimmed.toULongLong(&isNumber);
    if (!isNumber || number > std::numeric_limits<Value>::max()) return false;
    song.*Member = static_cast<Value>(number);
    return true;
}

bool SetYear(TID3Tag& song, const QString& text) {
    const QString year = text.trimmed().toUpper();
    if (!year.isEmpty() && !IsValidYearText(year)) return false;
    song.Year = year.isEmpty() ? u"0000"_s : year;
    return true;
}

bool SetGenre(TID3Tag& song, const QString& text) {
    const QString genre = text.trimmed();
    if (const auto named = GenreByName(genre)) {
        song.Genre = *named;
        return true;
    }
    if (!genre.isEmpty()) return SetNumber<&TID3Tag::Genre>(song, genre);
    song.Genre = kNoGenre;
    return true;
}

bool SetMainGenre(TID3Tag& song, const QString& text) {
    const QString genre = text.trimmed();
    const quint8 named = MainGenreNamed(genre);
    if (named != 0 || genre.isEmpty() || genre.compare(MainGenreLongName(0), Qt::CaseInsensitive) == 0) {
        song.MainGenre = named;
        return true;
    }
    TID3Tag numbered;
    if (!SetNumber<&TID3Tag::MainGenre>(numbered, genre) || numbered.MainGenre >= kMainGenreCount)
        return false;
    song.MainGenre = numbered.MainGenre;
    return true;
}

bool SetRemix(TID3Tag& song, const QString& text) {
    const QString answer = text.trimmed().toLower();
    if (!QStringList{u"ja"_s, u"nein"_s, u"true"_s, u"false"_s, u"1"_s, u"0"_s}.contains(answer))
        return false;
    song.Remix = answer == u"ja"_s || answer == u"true"_s || answer == u"1"_s;
    return true;
}

// Names of flags, or the whole word as a number. Bits without a name stay where names are given.
bool SetFlags(TID3Tag& song, const QString& text) {
    const QStringList names = SongFlagNames();
    quint32 flags = song.Flags & ~((1U << names.size()) - 1);
    for (const QString& part : text.split(u',', Qt::SkipEmptyParts)) {
        const auto named = std::ranges::find_if(names, [name = part.trimmed()](const QString& flag) {
            return flag.compare(name, Qt::CaseInsensitive) == 0;
        });
        if (named == names.end()) return !text.trimmed().isEmpty() && SetNumber<&TID3Tag::Flags>(song, text);
        flags |= 1U << (named - names.begin());
    }
    song.Flags = flags;
    return true;
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
     .FormName = "title",
     .Set = &SetText<&TID3Tag::Title>},
    {.Id = Id::Artist,
     .Caption = u"Artist",
     .ShortCaption = u"Artist",
     .Group = Group::Tag,
     .Text = &TextOf<&TID3Tag::Artist>,
     .Sort = stArtist,
     .FilterNames = u"artist interpret",
     .InPlainSearch = true,
     .FormName = "artist",
     .Set = &SetText<&TID3Tag::Artist>},
    {.Id = Id::Album,
     .Caption = u"Album",
     .ShortCaption = u"Album",
     .Group = Group::Tag,
     .Text = &TextOf<&TID3Tag::Album>,
     .Sort = stAlbum,
     .FilterNames = u"album",
     .InPlainSearch = true,
     .FormName = "album",
     .Set = &SetText<&TID3Tag::Album>},
    {.Id = Id::Year,
     .Caption = u"Jahr",
     .ShortCaption = u"Jahr",
     .Group = Group::Tag,
     .Text = &YearText,
     .Number = [](Song song) -> qint64 { return YearNumber(song.Year); },
     .Sort = stYear,
     .FilterNames = u"jahr year",
     .InPlainSearch = true,
     .FormName = "year",
     .Set = &SetYear,
     .Accepts = u"vier Ziffern"},
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
     .FormName = "mainGenre",
     .Set = &SetMainGenre,
     .Edited = &MainGenreEdited,
     .Accepts = u"eines der 20 Hauptgenres"},
    {.Id = Id::Genre,
     .Caption = u"Genre",
     .ShortCaption = u"ID3-Genre",
     .Group = Group::Tag,
     .Text = &GenreText,
     .FilterNames = u"id3genre",
     .FormName = "genre",
     .Set = &SetGenre,
     .Edited = &GenreEdited,
     .Accepts = u"ein Genre aus der Liste"},
    {.Id = Id::Track,
     .Caption = u"Track",
     .ShortCaption = u"Track",
     .Group = Group::Tag,
     .Text = &TrackText,
     .Number = &NumberOf<&TID3Tag::Track>,
     .FilterNames = u"track",
     .FormName = "track",
     .Set = &SetNumber<&TID3Tag::Track>,
     .Accepts = u"eine Zahl von 0 bis 255"},
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
     .FilterNames = u"beliebtheit playcount",
     .FormName = "playCount",
     .Set = &SetNumber<&TID3Tag::PlayCount>,
     .Accepts = u"eine Zahl"},
    {.Id = Id::Comment,
     .Caption = u"Kommentar",
     .ShortCaption = u"Kommentar",
     .Group = Group::Tag,
     .Text = &TextOf<&TID3Tag::Comment>,
     .Sort = stComment,
     .FilterNames = u"kommentar comment",
     .InPlainSearch = true,
     .FormName = "comment",
     .Set = &SetText<&TID3Tag::Comment>},
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
     .FilterNames = u"flag",
     .FormName = "flags",
     .Set = &SetFlags,
     .Edited = &FlagsEdited,
     .Accepts = u"Namen von Flags"},
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
    {.Id = Id::Remix,
     .Caption = u"Remix",
     .ShortCaption = u"Remix",
     .Group = Group::Tag,
     .Text = &RemixText,
     .FormName = "remix",
     .Set = &SetRemix,
     .Accepts = u"ja oder nein"},
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

QString EditText(const SongField& field, const TID3Tag& song) {
    return field.Edited != nullptr ? field.Edited(song) : field.Text(song);
}

QString SearchedText(const SongField& field, const TID3Tag& song) {
    if (field.Id != SongFieldId::MainGenre || song.Genre == kNoGenre) return field.Text(song);
    return MainGenreLongName(song.MainGenre) + u'\n' + GenreName(song.Genre);
}

std::span<const RecordMember> RecordMembers() {
    return kMembers;
}

TID3Tag MergedChange(TID3Tag song, const TID3Tag& before, const TID3Tag& after, MergeConflict conflict) {
    const auto take = [&](auto member) {
        const bool isFree = conflict == MergeConflict::TakesMerged || song.*member == before.*member;
        if (before.*member != after.*member && isFree) song.*member = after.*member;
    };
    for (const RecordMember& row : kMembers)
        std::visit(take, row.Member);
    return song;
}
