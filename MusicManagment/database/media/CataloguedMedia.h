#pragma once

#include <QSet>

#include "CommonRUKTools/Volumes.h"
#include "MusicManagment/database/MusicManagment.h"

// Which media are catalogued: those that have a name, and those that can be taken away and that songs of the
// collection lie on. Made for one run; a medium that is catalogued meanwhile is told to it.
class CataloguedMedia {
 public:
    explicit CataloguedMedia(const TMusicDatabase& database);

    // The path under which a song is stored: on a catalogued medium its CD path. One with a backslash in its
    // name, which a CD path cannot hold, keeps its ordinary path.
    QString StoredPath(const QString& path) const;
    bool IsCatalogued(const Volume& volume) const;
    bool HasSongs(quint32 serial) const { return ofSongs_.contains(serial); }

 private:
    // 0: none.
    quint32 SerialOf(const Volume& volume) const;

    QSet<quint32> named_;
    QSet<quint32> ofSongs_;
};

// Gives the volume on which `path` lies a name, so that songs on it are stored by it; without one its label
// or its serial number. Returns the name. Throws EMusicDatabaseException where the volume has no serial
// number or cannot be told.
QString CatalogueMedium(TMusicDatabase& database, const QString& path, const QString& name = QString());
// Whether the medium is mounted, or a copy is noted: what views ask for each song that they draw, so that no
// disk is looked at.
bool IsWithinReach(const TMusicDatabase& database, const QString& path);
