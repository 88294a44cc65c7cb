#pragma once

#include <atomic>
#include <optional>
#include <vector>

#include "CommonRUKTools/FileChange.h"
#include "CommonRUKTools/WorkAhead.h"
#include "MusicManagment/database/songfiles/SongUpdates.h"

// What becomes of a song's file when its tags change.
struct TagChange {
    FileState Before{};  // of the file that the patch was made for
    FilePatch Patch{};
};

// What the record of a song becomes that is like this now; its path stays.
TID3Tag RecordAfter(const SongUpdate& update, const TID3Tag& song);

// The changes of the files of several updates, one after the other. A few threads compute them ahead of their
// turn, so that the processor has something to do while a group of files is waited for.
class TagPlans {
 public:
    // The updates must live as long.
    TagPlans(TMusicDatabase& database, const std::vector<SongUpdate>& updates);

    // Moves to the next update.
    void Next();
    // Of that update's file, once, when this is what the song's record is to be; nothing where the file does
    // not change. Throws EStreamError.
    std::optional<TagChange> Take(const TID3Tag& record);

 private:
    struct Planned {
        TID3Tag Record{};
        std::int64_t Held = 0;            // bytes that wait with it
        std::optional<TagChange> Made{};  // nothing where too much would have waited
    };
    std::function<Planned()> WorkOf(std::size_t number);
    Planned Ahead(const SongUpdate& update, TID3Tag record);
    std::optional<TagChange> Ready(const TID3Tag& record);
    TagChange Plan(const SongUpdate& update, const TID3Tag& record) const;

    TMusicDatabase& database_;
    const std::vector<SongUpdate>& updates_;
    ReadProfile profile_;
    std::size_t taken_ = 0;  // updates that were moved to
    std::atomic<std::int64_t> held_ = 0;
    WorkAhead<Planned> work_;  // the last one: it waits for its threads
};
