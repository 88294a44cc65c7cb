#pragma once

#include "MusicManagment/database/MusicManagment.h"

// What the batches that make files of songs have in common.

// What came of them.
struct MediaBatchResult {
    int Done = 0;
    QStringList Failed{};   // path and reason
    QStringList Missing{};  // songs whose medium was not put in
    bool Stopped = false;
};

// A batch as the progress window shows it.
struct CopyProgress {
    TMusicDatabase& Database;
    qint64 Number = 0;
    qint64 Total = 0;

    // True when the user asked to stop.
    bool Reach(const QString& name, qint64 done, qint64 size) const;
};

// Tells how much is about to be copied into the folder, which need not exist yet, and how much room there is.
// False when the user does not want it.
bool MayCopy(TMusicDatabase& database, const std::vector<SongHandle>& songs, const QString& folder);

// Copies a file, making the folders of the target; what was there is replaced when the copy is whole. False
// when the user asked to stop. Throws EStreamError; the target is then as it was.
bool CopyWhole(const QString& from, const QString& to, const CopyProgress& progress);

// "12 Songs zwischengespeichert", and what did not go as wished.
void ReportMediaBatch(const MediaBatchResult& result, const QString& done);
