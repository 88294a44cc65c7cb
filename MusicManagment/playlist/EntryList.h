#pragma once

#include <QHash>
#include <memory>
#include <vector>

#include "CommonRUKTools/BlockedList.h"
#include "MusicManagment/playlist/PlayListTypes.h"

// The entries of a playlist and their playing time, which is kept up to date with every change.
class EntryList {
 public:
    int Count() const { return static_cast<int>(items_.size()); }
    // Stays valid while the entry is listed.
    const PlayListEntry& At(int index) const { return *ItemAt(index).Entry; }
    EntryId IdAt(int index) const { return ItemAt(index).Id; }
    // The first with this name; -1 none.
    int Find(const QString& name) const;
    // -1 when it is not listed any more.
    int Find(EntryId id) const;
    int Find(const RememberedEntry& entry) const;
    qint64 TotalSeconds() const { return seconds_; }

    void Insert(int position, PlayListEntry entry);
    void SetRecord(int index, TID3Tag record);
    // Gives the entries with these names others; returns where they stand.
    std::vector<int> Rename(const QHash<QString, QString>& names);
    void Remove(int index);
    void Clear();
    void Assign(std::vector<PlayListEntry> entries);
    // Brings the entries at `indices` (ascending and unique) before the one at `before`. Returns for each
    // position where its entry stood.
    std::vector<int> Move(const std::vector<int>& indices, int before);

 private:
    struct Item {
        std::unique_ptr<PlayListEntry> Entry;
        EntryId Id;
    };

    const Item& ItemAt(int index) const { return items_[static_cast<std::size_t>(index)]; }
    Item MakeItem(PlayListEntry entry);

    BlockedList<Item> items_;
    EntryId lastId_ = 0;
    qint64 seconds_ = 0;
};
