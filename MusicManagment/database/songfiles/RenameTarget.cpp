#include "MusicManagment/database/songfiles/RenameTarget.h"

#include <QDir>

#include "MusicManagment/database/songfiles/NamePattern.h"

QString RenameTargetByPattern(const TMusicDatabase& database, const QString& pattern, const QString& path,
                              const TID3Tag& info) {
    if (IsCdPath(path)) return path;
    if (database.MoveMP3sAfterGenreChange() && info.MainGenre != 0) {
        const QString& folder = database.MP3MoveSubDirs().at(info.MainGenre);
        const QString name = path.mid(path.lastIndexOf(u'/') + 1);
        return database.MP3MoveRootDir() + folder + u'/' + BuildNameFromPattern(pattern, name, info);
    }
    const QString renamed = BuildNameFromPattern(pattern, path, info);
    // The root folder stands in front of the whole old folder, as it always has.
    return database.RenameInPlace() ? renamed : QDir::cleanPath(database.MP3MoveRootDir() + renamed);
}

QString RenameTarget(const TMusicDatabase& database, const QString& path, const TID3Tag& info) {
    if (!database.RenameAndMoveMP3s()) return path;
    return RenameTargetByPattern(database, database.MP3NamePattern(), path, info);
}
