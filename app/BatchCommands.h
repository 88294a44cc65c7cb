#pragma once

#include "CommonRUKTools/Listeners.h"
#include "MusicManagment/database/batches/BatchSongs.h"

class SongListWidget;

// The batch commands about the songs that the list has marked, and those that take them off the disk. Each
// tells itself what came of it.
class BatchCommands {
 public:
    BatchCommands(TMusicDatabase& database, SongListWidget& list);

 private:
    BatchSongs Chosen() const;
    void AdaptGenre();
    void VerifyLengths();
    void EnterLength();
    void ChangeFlag(int id);
    void RemoveTags();
    void RereadTags();
    void Discard(int id);
    void RenameByPattern();
    void EditBannList();

    TMusicDatabase& database_;
    SongListWidget& list_;
    Subscriptions handlers_;
};
