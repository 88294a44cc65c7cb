#include "MusicManagment/playlist/EntryList.h"

#include <algorithm>

namespace {

qint64 SecondsOf(const PlayListEntry& entry) {
    return entry.Record ? entry.Record->Length : 0;
}

}  // namespace

int EntryList::Find(const QString& name) const {
    if (name.isEmpty()) return -1;
    int index = 0;
    for (const auto& entry : entries_) {
        if (entry->Name == name) return index;
        ++index;
    }
    return -1;
}

void EntryList::Insert(int position, PlayListEntry entry) {
    seconds_ += SecondsOf(entry);
    entries_.insert(static_cast<std::size_t>(position), std::make_unique<PlayListEntry>(std::move(entry)));
}

void EntryList::SetRecord(int index, TID3Tag record) {
    PlayListEntry& entry = *entries_[static_cast<std::size_t>(index)];
    seconds_ -= SecondsOf(entry);
    entry.Record = std::move(record);
    seconds_ += SecondsOf(entry);
}

void EntryList::Remove(int index) {
    seconds_ -= SecondsOf(At(index));
    entries_.removeAt(static_cast<std::size_t>(index));
}

void EntryList::Clear() {
    entries_.clear();
    seconds_ = 0;
}

void EntryList::Assign(std::vector<PlayListEntry> entries) {
    Clear();
    std::vector<std::unique_ptr<PlayListEntry>> owned;
    owned.reserve(entries.size());
    for (PlayListEntry& entry : entries) {
        seconds_ += SecondsOf(entry);
        owned.push_back(std::make_unique<PlayListEntry>(std::move(entry)));
    }
    entries_.assign(std::move(owned));
}

int EntryList::Move(const std::vector<int>& indices, int before) {
    auto entries = entries_.takeAll();
    std::vector<bool> moves(entries.size(), false);
    for (const int index : indices)
        moves[static_cast<std::size_t>(index)] = true;

    std::vector<std::unique_ptr<PlayListEntry>> above, moved, below;
    for (std::size_t i = 0; i < entries.size(); ++i) {
        auto& target = moves[i] ? moved : static_cast<int>(i) < before ? above : below;
        target.push_back(std::move(entries[i]));
    }
    const auto first = static_cast<int>(above.size());
    std::ranges::move(moved, std::back_inserter(above));
    std::ranges::move(below, std::back_inserter(above));
    entries_.assign(std::move(above));
    return first;
}
