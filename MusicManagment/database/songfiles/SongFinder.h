#pragma once

#include <QSet>

#include "MusicManagment/database/MusicManagment.h"

// Finds the files of many songs. A medium that the user has once not put in is not asked for again.
class SongFinder {
 public:
    explicit SongFinder(TMusicDatabase& database) : database_(database) {}

    // Empty when the medium is not there.
    QString Find(const QString& path, ResolveOptions options = {}) {
        const quint32 serial = SerialOfCdPath(path);
        options.Ask = options.Ask && !notThere_.contains(serial);
        QString file = database_.ResolveSongPath(path, options);
        if (file.isEmpty() && IsCdPath(path)) notThere_.insert(serial);
        return file;
    }

 private:
    TMusicDatabase& database_;
    QSet<quint32> notThere_;
};
