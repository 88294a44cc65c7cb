#pragma once

#include <QSet>

#include "CommonRUKTools/Volumes.h"
#include "MusicManagment/database/MusicManagment.h"

// Section of the side file: names of media, by their serial number in 8 digits. They go with the database
// where the user's own list of names does not know a medium.
inline const QString kMediumNames = QStringLiteral("medium-name");

// Which media are catalogued: those that have a name, and those that can be taken away and that songs of the
// collection lie on. Made for one run: what is catalogued later it does not know.
class CataloguedMedia {
 public:
    explicit CataloguedMedia(const TMusicDatabase& database);

    // The path under which a song is stored: on a catalogued medium its CD path. One with a backslash in its
    // name, which a CD path cannot hold, keeps its ordinary path.
    QString StoredPath(const QString& path) const;
    // The number by which a volume is catalogued; 0: it is not.
    quint32 SerialOf(const Volume& volume) const;
    bool IsCatalogued(const Volume& volume) const { return SerialOf(volume) != 0; }

 private:
    QSet<quint32> named_;
    QSet<quint32> ofSongs_;
};

// Gives the volume on which `path` lies a name, so that songs on it are stored by it; without one the name
// that it has, its label or its serial number. Returns the name. Throws EMusicDatabaseException where the
// volume has no serial number or cannot be told.
QString CatalogueMedium(TMusicDatabase& database, const QString& path, const QString& name = QString());
// The same for a medium that is known by its number and need not be there any more.
QString NameMedium(TMusicDatabase& database, quint32 serial, const QString& name, const QString& label);

// A stored path as messages show it: "[Urlaub] \Lieder\a.mp3" of a song on a medium that has a name.
QString PathForPeople(const TMusicDatabase& database, const QString& path);

// What views ask for each song that they draw, so that no disk is looked at: the file on the medium where it
// is mounted, else the copy that is noted; empty where there is neither. An ordinary path is its own answer.
QString FileWithinReach(const TMusicDatabase& database, const QString& path);
