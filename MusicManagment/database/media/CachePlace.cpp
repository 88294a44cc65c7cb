#include "MusicManagment/database/media/CachePlace.h"

#include "CommonRUKTools/FileSource.h"
#include "MusicManagment/database/songfiles/NamePattern.h"

using namespace Qt::StringLiterals;

namespace {

QString WithExtension(const QString& path, const QString& extension) {
    const qsizetype dot = path.lastIndexOf(u'.');
    return (dot > path.lastIndexOf(u'/') ? path.left(dot) : path) + extension;
}

}  // namespace

QString CachePlace(const TMusicDatabase& database, const TID3Tag& song) {
    const QString name = song.FileName.mid(LastSeparator(song.FileName) + 1);
    const int genre = song.MainGenre < kMainGenreCount ? song.MainGenre : 0;
    return database.MP3MoveRootDir() + database.MP3MoveSubDirs().at(genre) + u'/' +
           BuildNameFromPattern(database.MP3NamePattern(), name, song);
}

QString CachedCopy(const TMusicDatabase& database, const QString& cdPath) {
    const TID3Tag* song = database.Songs().Find(cdPath);
    if (song == nullptr) return {};
    const QString place = CachePlace(database, *song);
    QStringList places = {place, WithExtension(place, u".wma"_s)};
    places += database.Side().Values(kCacheSection, cdPath);
    for (const QString& copy : places)
        if (FileSource::Exists(copy)) return copy;
    return {};
}
