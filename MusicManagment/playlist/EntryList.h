#pragma once

#include <memory>
#include <vector>

#include "CommonRUKTools/BlockedList.h"
#include "MusicManagment/playlist/PlayListTypes.h"

// The entries of a playlist and their playing time, which is kept up to date with every change.
class EntryList {
 public:
    int Count() const { return static_cast<int>(entries_.size()); }
    const PlayListEntry& At(int index) const { return *entries_[static_cast<std::size_t>(index)]; }
    // The first with this name; -1 none.
    int Find(const QString& name) const;
    qint64 TotalSeconds() const { return seconds_; }

    void Insert(int position, PlayListEntry entry);
    void SetRecord(int index, TID3Tag record);
    void Remove(int index);
    void Clear();
    void Assign(std::vector<PlayListEntry> entries);
    // `indices` ascending and unique. Returns the new position of the first.
    int Move(const std::vector<int>& indices, int before);

 private:
    BlockedList<std::unique_ptr<PlayListEntry>> entries_;
    qint64 seconds_ = 0;
};
