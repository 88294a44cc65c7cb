#include "app/models/SongProperties.h"

#include <QLocale>
#include <QStringList>
#include <algorithm>

#include "CommonRUKTools/Clock.h"
#include "MusicManagment/database/SongTypes.h"
#include "ReadMPEGHeader/DisplayTexts.h"
#include "ReadMPEGHeader/Genres.h"

using namespace Qt::StringLiterals;

namespace {

void AddText(std::vector<PropertyRow>& rows, const QString& name, const QString& value) {
    if (!value.isEmpty()) rows.push_back({name, value});
}

// A path on a CD keeps its own separators on every system.
qsizetype LastSeparator(const QString& path) {
    const qsizetype slash = path.lastIndexOf(u'/');
    return IsCdPath(path) ? std::max(slash, path.lastIndexOf(u'\\')) : slash;
}

}  // namespace

QString ShownYear(const TID3Tag& song) {
    const bool onlyZeros = std::ranges::all_of(song.Year, [](QChar c) { return c == u'0'; });
    return onlyZeros ? QString() : song.Year;
}

QString ShownGenre(const TID3Tag& song) {
    return GenreName(song.Genre) + (song.Remix ? u" (Remix)"_s : QString());
}

QString ShownTrack(const TID3Tag& song) {
    return song.Track != 0 ? QString::number(song.Track) : QString();
}

std::vector<PropertyRow> PathProperties(const TID3Tag& song) {
    const QString& path = song.FileName;
    const qsizetype separator = LastSeparator(path);
    std::vector<PropertyRow> rows;
    AddText(rows, u"Name"_s, path.mid(separator + 1));
    AddText(rows, u"Ordner"_s, path.left(std::max<qsizetype>(separator, separator == 0 ? 1 : 0)));
    return rows;
}

std::vector<PropertyRow> TagProperties(const TID3Tag& song) {
    std::vector<PropertyRow> rows;
    AddText(rows, u"Titel"_s, song.Title);
    AddText(rows, u"Artist"_s, song.Artist);
    AddText(rows, u"Album"_s, song.Album);
    AddText(rows, u"Jahr"_s, ShownYear(song));
    AddText(rows, u"Track"_s, ShownTrack(song));
    AddText(rows, u"Genre"_s, ShownGenre(song));
    AddText(rows, u"Kommentar"_s, song.Comment);
    return rows;
}

std::vector<PropertyRow> TechnicalProperties(const TID3Tag& song) {
    std::vector<PropertyRow> rows;
    AddText(rows, u"Format"_s, song.MPEGLayer);
    AddText(rows, u"Länge"_s, FormatLength(song.Length, true));
    AddText(rows, u"Bitrate"_s, FormatBitRate(song.BitRate));
    AddText(rows, u"Abtastrate"_s, FormatSampleRate(song.SampleRate));
    AddText(rows, u"Kanäle"_s, FormatChannelMode(song.ChannelMode));
    AddText(rows, u"Emphasis"_s, FormatEmphasis(song.Emphasis));
    AddText(rows, u"Kennzeichen"_s, FormatHeaderFlags(song));
    if (song.FrameSize != 0)
        AddText(rows, u"Framegröße"_s, QLocale(QLocale::German).toString(song.FrameSize) + u" Bytes"_s);
    return rows;
}

std::vector<PropertyRow> CollectionProperties(const TID3Tag& song) {
    std::vector<PropertyRow> rows;
    AddText(rows, u"Hauptgenre"_s, MainGenreLongName(song.MainGenre));
    AddText(rows, u"Beliebtheit"_s, QString::number(song.PlayCount));
    AddText(rows, u"Flags"_s, FormatSongFlags(song.Flags));
    if (song.AddTime > 0)
        AddText(rows, u"Hinzugefügt am"_s, FromDayCount(song.AddTime).toString(u"dd.MM.yyyy hh:mm"_s));
    return rows;
}

QString PropertyLine(const PropertyRow& row) {
    return row.Name + u": "_s + row.Value;
}

QString PropertyText(const std::vector<PropertyGroup>& groups) {
    QStringList lines;
    for (const PropertyGroup& group : groups) {
        if (group.Rows.empty()) continue;
        if (!lines.isEmpty()) lines << QString();
        lines << group.Caption;
        for (const PropertyRow& row : group.Rows)
            lines << PropertyLine(row);
    }
    return lines.join(u'\n');
}
