#pragma once

#include <cstddef>
#include <functional>
#include <memory>
#include <unordered_set>
#include <vector>

#include "CommonRUKTools/BlockedList.h"
#include "MusicManagment/database/SongTypes.h"
#include "ReadMPEGHeader/ID3Tag.h"

// Names one song of a list as long as it is there, wherever it stands. A song that has been removed and
// brought back is another one.
struct SongHandle {
    quint32 Slot = 0;
    quint32 Serial = 0;  // 0 names no song

    bool operator==(const SongHandle&) const = default;
};

// A record of the list, and how the list finds it.
struct SongEntry : TID3Tag {
    SongEntry() = default;
    explicit SongEntry(TID3Tag record) : TID3Tag(std::move(record)) {}

    quint32 Slot = 0;
    quint32 Block = 0;
};

// Owns the song entries, one record each, in list order, and finds them by path and by handle. The index over
// the paths is built at the first question and kept up from then on.
class SongList {
 public:
    using Entry = std::unique_ptr<SongEntry>;

    std::size_t Count() const { return entries_.size(); }
    const TID3Tag& At(SongIndex index) const { return *entries_[static_cast<std::size_t>(index)]; }

    auto begin() const { return entries_.begin(); }
    auto end() const { return entries_.end(); }

    SongHandle Append(TID3Tag record);
    // Puts `record` in the place of the one at `index`, which it returns; the path index follows.
    TID3Tag Exchange(SongIndex index, TID3Tag record);
    // Returns the record that stood there.
    TID3Tag Remove(SongIndex index);
    void Move(SongIndex from, SongIndex to);  // `to` counted after the removal
    void Clear();

    // Takes all entries out, in list order, and back in another order; none may be missing.
    std::vector<Entry> TakeAll();
    void PutAll(std::vector<Entry> entries);

    // Builds the index over the paths now if it is not there. Tells `progress` every few thousand songs how
    // many are done; true from it gives up. The list must not change meanwhile.
    void IndexPaths(const std::function<bool(std::size_t done)>& progress) const;
    // nullptr when no song has this path.
    const TID3Tag* Find(const QString& fileName) const;
    // nullptr when the song is no longer there.
    const TID3Tag* Find(SongHandle song) const { return EntryOf(song); }

    SongHandle HandleOf(SongIndex index) const { return HandleOf(At(index)); }
    // `record` is one of this list.
    SongHandle HandleOf(const TID3Tag& record) const;
    // List position in O(log n); -1 when the song is no longer there.
    SongIndex PositionOf(SongHandle song) const;
    // The same for a record of this list.
    SongIndex PositionOf(const TID3Tag& record) const;

 private:
    struct PathHash {
        using is_transparent = void;
        std::size_t operator()(const TID3Tag* record) const { return qHash(record->FileName); }
        std::size_t operator()(const QString& path) const { return qHash(path); }
    };
    struct SamePath {
        using is_transparent = void;
        bool operator()(const TID3Tag* a, const TID3Tag* b) const { return a->FileName == b->FileName; }
        bool operator()(const QString& path, const TID3Tag* b) const { return path == b->FileName; }
        bool operator()(const TID3Tag* a, const QString& path) const { return a->FileName == path; }
    };
    using PathIndex = std::unordered_multiset<const TID3Tag*, PathHash, SamePath>;
    struct NoteBlock {
        static void Put(Entry& entry, quint32 block) { entry->Block = block; }
    };
    struct Slot {
        const SongEntry* Entry = nullptr;
        quint32 Serial = 0;  // of the song that has it; 0 none
    };

    void Unindex(const TID3Tag* record);
    void TakeSlot(SongEntry& entry);
    const SongEntry* EntryOf(SongHandle song) const;

    BlockedList<Entry, NoteBlock> entries_;
    std::vector<Slot> slots_;
    std::vector<quint32> freeSlots_;
    quint32 lastSerial_ = 0;
    mutable std::unique_ptr<PathIndex> paths_;
};
