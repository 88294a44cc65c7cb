#include "MusicManagment/database/media/CachePlace.h"

#include "CommonRUKTools/FileSource.h"
#include "MusicManagment/database/songfiles/NamePattern.h"

using namespace Qt::StringLiterals;

namespace {

const QString kOwnSection = QStringLiteral("own");
// Such a file is no song any more: when songs get other paths its own does not follow.
const QString kFileMark = QStringLiteral("file:");

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
    places += NotedFiles(database, cdPath);
    for (const QString& copy : places)
        if (FileSource::Exists(copy)) return copy;
    return {};
}

void NoteOwnFile(TMusicDatabase& database, const QString& cdPath, const QString& file) {
    database.Side().Add(kOwnSection, {cdPath, kFileMark + file});
    database.SetModified(true);
}

std::vector<SideRow> OwnFiles(const TMusicDatabase& database) {
    std::vector<SideRow> rows = database.Side().Rows(kOwnSection);
    for (SideRow& row : rows)
        row.Value.remove(0, kFileMark.size());
    return rows;
}

QStringList NotedFiles(const TMusicDatabase& database, const QString& cdPath) {
    QStringList files = database.Side().Values(kCacheSection, cdPath);
    for (const QString& own : database.Side().Values(kOwnSection, cdPath))
        files << own.mid(kFileMark.size());
    return files;
}
