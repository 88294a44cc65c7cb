#include "app/models/SongMime.h"

#include <QCoreApplication>
#include <QDataStream>
#include <QIODevice>
#include <QUrl>

#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/playlist/ListNames.h"
#include "MusicManagment/playlist/PlayList.h"

using namespace Qt::StringLiterals;

namespace {

constexpr auto kFiles = u"text/uri-list";

// Positions in the database mean nothing to a second run of this program.
QString OwnFormat() {
    return u"application/x-tunestead-songs-%1"_s.arg(QCoreApplication::applicationPid());
}

QByteArray FilesOf(const std::vector<SongRef>& songs) {
    QByteArray lines;
    for (const SongRef& song : songs) {
        if (IsCdPath(song.Name)) continue;  // no other program knows the CD
        const QUrl url = IsAddress(song.Name) ? QUrl(song.Name) : QUrl::fromLocalFile(song.Name);
        lines += url.toEncoded() + "\r\n";
    }
    return lines;
}

QByteArray Pack(const std::vector<SongRef>& songs) {
    QByteArray bytes;
    QDataStream stream(&bytes, QIODevice::WriteOnly);
    for (const SongRef& song : songs)
        stream << song.Name << song.Hint;
    return bytes;
}

std::vector<SongRef> Unpack(const QByteArray& bytes) {
    std::vector<SongRef> songs;
    QDataStream stream(bytes);
    while (!stream.atEnd()) {
        SongRef song;
        stream >> song.Name >> song.Hint;
        if (stream.status() != QDataStream::Ok) break;
        songs.push_back(std::move(song));
    }
    return songs;
}

SongIndex PlaceOf(const TMusicDatabase& database, const SongRef& song) {
    const bool hintIsRight =
        song.Hint >= 0 && song.Hint < database.Count() && database.Song(song.Hint).FileName == song.Name;
    return hintIsRight ? song.Hint : database.IndexOf(song.Name);
}

// A song that the database has lost in the meantime is taken as a file.
void InsertSong(TPlayList& list, int position, const SongRef& song) {
    const TMusicDatabase* database = list.MusicDatabase();
    const SongIndex place = database != nullptr ? PlaceOf(*database, song) : -1;
    if (place >= 0)
        list.InsertSong(position, place);
    else
        list.Insert(position, {.Name = song.Name});
}

}  // namespace

QStringList SongMimeData::formats() const {
    return DropFormats();
}

QVariant SongMimeData::retrieveData(const QString& format, QMetaType) const {
    if (format == QStringView(kFiles)) return FilesOf(songs_);
    return format == OwnFormat() ? Pack(songs_) : QVariant();
}

QStringList DropFormats() {
    return {OwnFormat(), QString::fromUtf16(kFiles)};
}

DroppedSongs ReadDrop(const QMimeData& data) {
    if (data.hasFormat(OwnFormat())) return {.Songs = Unpack(data.data(OwnFormat()))};
    DroppedSongs drop;
    for (const QUrl& url : data.urls())
        if (url.isLocalFile()) drop.Paths << url.toLocalFile();
    return drop;
}

int InsertDrop(TPlayList& list, int position, const DroppedSongs& drop) {
    if (drop.Songs.empty()) return list.InsertFiles(position, drop.Paths);
    for (const SongRef& song : drop.Songs)
        InsertSong(list, position++, song);
    return static_cast<int>(drop.Songs.size());
}
