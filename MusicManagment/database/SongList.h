#pragma once

#include <cstddef>
#include <functional>
#include <memory>
#include <unordered_set>
#include <vector>

#include "CommonRUKTools/BlockedList.h"
#include "MusicManagment/database/SongTypes.h"
#include "ReadMPEGHeader/ID3Tag.h"

// Owns the song entries, one record each, in list order, and finds them by path. The index over the paths is
// built at the first question and kept up from then on.
class SongList {
 public:
    using Entry = std::unique_ptr<TID3Tag>;

    std::size_t Count() const { return entries_.size(); }
    const TID3Tag& At(SongIndex index) const { return *entries_[static_cast<std::size_t>(index)]; }

    auto begin() const { return entries_.begin(); }
    auto end() const { return entries_.end(); }

    void Append(Entry entry);
    // Replaces the record at `index`; the path index follows.
    void Set(SongIndex index, TID3Tag record);
    void Remove(SongIndex index);
    void Move(SongIndex from, SongIndex to);  // `to` counted after the removal
    void Clear();

    // Takes all entries out, in list order, and back in another order.
    std::vector<Entry> TakeAll();
    void PutAll(std::vector<Entry> entries);

    // Builds the index over the paths now if it is not there. Tells `progress` every few thousand songs how
    // many are done; true from it gives up. The list must not change meanwhile.
    void IndexPaths(const std::function<bool(std::size_t done)>& progress) const;
    // nullptr when no song has this path.
    const TID3Tag* Find(const QString& fileName) const;
    // List position of a record of this list; linear.
    SongIndex PositionOf(const TID3Tag* record) const;

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

    void Unindex(const TID3Tag* record);

    BlockedList<Entry> entries_;
    mutable std::unique_ptr<PathIndex> paths_;
};
