#pragma once

#include <QStringList>
#include <vector>

#include "MusicManagment/database/MusicManagment.h"

// Reading a backup medium: songs that were put on a disc or a disk once are found again in the collection.

// The medium, which need not be catalogued yet.
struct BackupMedium {
    QString MountPoint{};
    QString Label{};
    quint32 Serial = 0;  // by which its songs are stored
};

// A song file on it.
struct BackupFile {
    QString Path{};  // where it lies now
    TID3Tag Tag{};   // what it says of itself, under the path by which it would be stored
    qint64 Size = 0;
};

struct BackupContents {
    std::vector<BackupFile> Files{};
    int Known = 0;             // files that are in the collection by their place on the medium
    QStringList Unreadable{};  // files and folders, each with the reason
    bool Stopped = false;      // by the user; the files are those read so far
};

// The medium on which a folder lies. Throws EMusicDatabaseException where it has no serial number, or is one
// that cannot be taken away and is not catalogued: songs on it need no other paths.
BackupMedium BackupMediumOf(const TMusicDatabase& database, const QString& folder);

// Reads the song files in a folder of the medium and below. A long operation. Throws EAbort, after telling
// the user, when another one runs.
BackupContents ReadBackup(TMusicDatabase& database, const BackupMedium& medium, const QString& folder);
