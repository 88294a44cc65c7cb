#pragma once

#include <QString>
#include <QStringList>

#include "MusicManagment/database/MusicManagment.h"

struct CopyResult {
    int Copied = 0;
    QStringList Failed;  // path and reason
    bool Stopped = false;
};

// Copies the files of songs into a folder, with progress. A file of the same name is only replaced when the
// user says so. A copy that fails or is stopped half-way leaves nothing behind.
CopyResult CopySongs(TMusicDatabase& database, const QStringList& paths, const QString& folder);
