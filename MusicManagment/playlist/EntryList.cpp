#include "MusicManagment/playlist/EntryList.h"

#include <algorithm>

namespace {

qint64 SecondsOf(const PlayListEntry& entry) {
    return entry.Record ? entry.Record->Length : 0;
}

template <typename List, typename Predicate>
int FirstThat(const List& items, Predicate fits) {
    int index = 0;
    for (const auto& item : items) {
        if (fits(item)) return index;
        ++index;
    }
    return -1;
}

}  // namespace

int EntryList::Find(const QString& name) const {
    if (name.isEmpty()) return -1;
    return FirstThat(items_, [&name](const Item& item) { return item.Entry->Name == name; });
}

int EntryList::Find(EntryId id) const {
    if (id == 0) return -1;
    return FirstThat(items_, [id](const Item& item) { return item.Id == id; });
}

int EntryList::Find(const RememberedEntry& entry) const {
    const int index = Find(entry.Id);
    return index >= 0 ? index : Find(entry.Name);
}

EntryList::Item EntryList::MakeItem(PlayListEntry entry) {
    seconds_ += SecondsOf(entry);
    return {std::make_unique<PlayListEntry>(std::move(entry)), ++lastId_};
}

void EntryList::Insert(int position, PlayListEntry entry) {
    items_.insert(static_cast<std::size_t>(position), MakeItem(std::move(entry)));
}

void EntryList::SetRecord(int index, TID3Tag record) {
    PlayListEntry& entry = *ItemAt(index).Entry;
    seconds_ -= SecondsOf(entry);
    entry.Record = std::move(record);
    seconds_ += SecondsOf(entry);
}

std::vector<int> EntryList::Rename(const QHash<QString, QString>& names) {
    std::vector<int> renamed;
    int index = 0;
    for (const Item& item : items_) {
        if (const auto name = names.constFind(item.Entry->Name); name != names.constEnd()) {
            item.Entry->Name = *name;
            renamed.push_back(index);
        }
        ++index;
    }
    return renamed;
}

void EntryList::Remove(int index) {
    seconds_ -= SecondsOf(At(index));
    items_.removeAt(static_cast<std::size_t>(index));
}

void EntryList::Clear() {
    items_.clear();
    seconds_ = 0;
}

void EntryList::Assign(std::vector<PlayListEntry> entries) {
    Clear();
    std::vector<Item> items;
    items.reserve(entries.size());
    for (PlayListEntry& entry : entries)
        items.push_back(MakeItem(std::move(entry)));
    items_.assign(std::move(items));
}

std::vector<int> EntryList::Move(const std::vector<int>& indices, int before) {
    std::vector<int> former;
    former.reserve(items_.size());
    const auto addOthers = [&](int first, int last) {
        for (int index = first; index < last; ++index)
            if (!std::ranges::binary_search(indices, index)) former.push_back(index);
    };
    before = std::clamp(before, 0, Count());
    addOthers(0, before);
    former.insert(former.end(), indices.begin(), indices.end());
    addOthers(before, Count());

    auto items = items_.takeAll();
    std::vector<Item> moved;
    moved.reserve(items.size());
    for (const int index : former)
        moved.push_back(std::move(items[static_cast<std::size_t>(index)]));
    items_.assign(std::move(moved));
    return former;
}
