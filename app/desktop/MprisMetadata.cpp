#include "app/desktop/MprisMetadata.h"

#include <QFileInfo>
#include <QUrl>
#include <algorithm>
#include <limits>

using namespace Qt::StringLiterals;

namespace {

constexpr qint64 kMicroseconds = 1000;  // in a millisecond

const QString kEntry = u"/tunestead/entry/"_s;

}  // namespace

QDBusObjectPath TrackOfEntry(EntryId entry) {
    if (entry == 0) return QDBusObjectPath(u"/org/mpris/MediaPlayer2/TrackList/NoTrack"_s);
    return QDBusObjectPath(kEntry + QString::number(entry));
}

EntryId EntryOfTrack(const QDBusObjectPath& track) {
    const QString path = track.path();
    return path.startsWith(kEntry) ? path.mid(kEntry.size()).toULongLong() : 0;
}

QVariantMap MprisMetadata(const QDBusObjectPath& track, const PlayingSong& song, qint64 milliseconds,
                          const QString& coverUrl) {
    QVariantMap data{{u"mpris:trackid"_s, QVariant::fromValue(track)}};
    if (song.FileName.isEmpty()) return data;
    data[u"xesam:title"_s] = song.Title;
    if (!song.Artist.isEmpty()) data[u"xesam:artist"_s] = QStringList(song.Artist);
    if (!song.Album.isEmpty()) data[u"xesam:album"_s] = song.Album;
    if (song.Track > 0) data[u"xesam:trackNumber"_s] = song.Track;
    if (milliseconds > 0) data[u"mpris:length"_s] = milliseconds * kMicroseconds;
    if (!coverUrl.isEmpty()) data[u"mpris:artUrl"_s] = coverUrl;
    data[u"xesam:useCount"_s] =
        static_cast<int>(std::min<qint64>(song.PlayCount, std::numeric_limits<int>::max()));
    // Songs on media have names of their own.
    if (QFileInfo(song.FileName).isAbsolute())
        data[u"xesam:url"_s] = QString::fromLatin1(QUrl::fromLocalFile(song.FileName).toEncoded());
    return data;
}
