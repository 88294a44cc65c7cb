#pragma once

#include <vector>

#include "MusicManagment/database/journal/Journal.h"

// What the batches of the journal mean for each other, and its upkeep.

// The steps of a batch that still stand, by their numbers.
struct RestOfBatch {
    const StoredBatch* Batch = nullptr;
    std::vector<quint32> Steps{};
};

// In the order in which they were done. What has been taken back, and what was taken back before something
// else was done, is in neither.
struct JournalLists {
    std::vector<RestOfBatch> ToUndo{};
    std::vector<RestOfBatch> ToRedo{};
};
JournalLists ListsOf(const JournalContents& contents);

bool HasUnfinished(const JournalContents& contents);
// Takes back what is half done and ends the batch.
RecoveryResult Recover(JournalFile& file);
// Until the limits are kept. What is still half done stays.
void DropOldest(JournalFile& file, const JournalLimits& limits);

bool IsSameDatabase(const TMusicDatabase& database, const QString& path);
