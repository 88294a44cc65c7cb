#include "bench/SongGenerator.h"

#include <QDir>
#include <algorithm>

#include "CommonRUKTools/Errors.h"
#include "bench/SongFile.h"
#include "bench/SongNames.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kSongsOfAnAlbum = 12;
constexpr int kSongsOfAnArtist = 60;

SongFile Song(int number, int artist, int album, std::size_t coverBytes) {
    SongFile song;
    song.Title = SongNames::Title(number);
    song.Artist = SongNames::Artist(artist);
    song.Album = SongNames::Album(artist, album);
    song.Year = 1960 + (artist * 7 + album * 3) % 64;
    song.Track = 1 + number % kSongsOfAnAlbum;
    song.Genre = artist % 80;
    song.TagVersion = number % 2 == 0 ? 3 : 4;
    song.CoverBytes = number / 2 % 2 == 0 ? coverBytes : 0;
    song.Vbr = number % 3 == 0;
    song.AudioBytes = 100'000 + number * 7919LL % 900'000;
    return song;
}

}  // namespace

QStringList SongGenerator::Write(const QString& folder) const {
    const int artists = Artists > 0 ? Artists : 1 + Songs / kSongsOfAnArtist;
    const int albums = (Songs + kSongsOfAnAlbum - 1) / kSongsOfAnAlbum;
    const QDir root(folder);
    QStringList paths;
    paths.reserve(Songs);
    for (int album = 0; album < albums; ++album) {
        const int artist = album % artists;
        const int first = album * kSongsOfAnAlbum;
        const SongFile sample = Song(first, artist, album, 0);
        const QString place = sample.Artist + u'/' + QString::number(sample.Year) + u" - "_s + sample.Album +
                              u' ' + QString::number(album);
        if (!root.mkpath(place))
            throw EStreamError(u"Kann den Ordner nicht anlegen: "_s + root.filePath(place));
        for (int number = first; number < std::min(first + kSongsOfAnAlbum, Songs); ++number) {
            SongFile song = Song(number, artist, album, CoverBytes);
            if (AudioBytes > 0) {
                song.AudioBytes = AudioBytes;
                song.HasHole = false;
            }
            const QString name =
                song.Artist + u" - "_s + song.Title + u" ("_s + QString::number(number) + u").mp3"_s;
            paths.push_back(root.filePath(place + u'/' + name));
            WriteSongFile(paths.back(), song);
        }
    }
    return paths;
}
