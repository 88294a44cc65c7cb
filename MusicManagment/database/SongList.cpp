#include "MusicManagment/database/SongList.h"

#include <algorithm>
#include <utility>

SongHandle SongList::Append(TID3Tag record) {
    auto entry = std::make_unique<SongEntry>(std::move(record));
    TakeSlot(*entry);
    const SongHandle song = HandleOf(*entry);
    if (paths_) paths_->insert(entry.get());
    entries_.append(std::move(entry));
    return song;
}

TID3Tag SongList::Exchange(SongIndex index, TID3Tag record) {
    SongEntry& entry = *entries_[static_cast<std::size_t>(index)];
    TID3Tag& target = entry;
    const bool moves = paths_ && target.FileName != record.FileName;
    if (moves) Unindex(&entry);
    TID3Tag before = std::exchange(target, std::move(record));
    if (moves) paths_->insert(&entry);
    return before;
}

TID3Tag SongList::Remove(SongIndex index) {
    const auto at = static_cast<std::size_t>(index);
    SongEntry& entry = *entries_[at];
    if (paths_) Unindex(&entry);
    slots_[entry.Slot] = {};
    freeSlots_.push_back(entry.Slot);
    TID3Tag record = std::move(static_cast<TID3Tag&>(entry));
    entries_.removeAt(at);
    return record;
}

void SongList::Move(SongIndex from, SongIndex to) {
    Entry entry = std::move(entries_[static_cast<std::size_t>(from)]);
    entries_.removeAt(static_cast<std::size_t>(from));
    entries_.insert(static_cast<std::size_t>(to), std::move(entry));
}

void SongList::Clear() {
    paths_.reset();
    entries_.clear();
    slots_.clear();
    freeSlots_.clear();
}

std::vector<SongList::Entry> SongList::TakeAll() {
    return entries_.takeAll();
}

void SongList::PutAll(std::vector<Entry> entries) {
    entries_.assign(std::move(entries));
}

void SongList::IndexPaths(const std::function<bool(std::size_t done)>& progress) const {
    if (paths_) return;
    constexpr std::size_t kStep = 1 << 14;
    // Whoever asks for a song meanwhile finds no half index.
    auto paths = std::make_unique<PathIndex>(entries_.size());
    for (const Entry& entry : entries_) {
        paths->insert(entry.get());
        if (paths->size() % kStep == 0 && progress && progress(paths->size())) return;
    }
    paths_ = std::move(paths);
}

const TID3Tag* SongList::Find(const QString& fileName) const {
    IndexPaths(nullptr);
    const auto found = paths_->find(fileName);
    return found != paths_->end() ? *found : nullptr;
}

SongHandle SongList::HandleOf(const TID3Tag& record) const {
    const auto slot = static_cast<const SongEntry&>(record).Slot;
    return {slot, slots_[slot].Serial};
}

SongIndex SongList::PositionOf(SongHandle song) const {
    const SongEntry* entry = EntryOf(song);
    return entry != nullptr ? PositionOf(*entry) : -1;
}

SongIndex SongList::PositionOf(const TID3Tag& record) const {
    const auto& wanted = static_cast<const SongEntry&>(record);
    return static_cast<SongIndex>(
        entries_.PositionIn(wanted.Block, [&wanted](const Entry& entry) { return entry.get() == &wanted; }));
}

void SongList::Unindex(const TID3Tag* record) {
    const auto [first, last] = paths_->equal_range(record);
    const auto found = std::find(first, last, record);
    if (found != last) paths_->erase(found);
}

void SongList::TakeSlot(SongEntry& entry) {
    if (freeSlots_.empty()) {
        freeSlots_.push_back(static_cast<quint32>(slots_.size()));
        slots_.emplace_back();
    }
    entry.Slot = freeSlots_.back();
    freeSlots_.pop_back();
    if (++lastSerial_ == 0) lastSerial_ = 1;  // after four billion songs
    slots_[entry.Slot] = {&entry, lastSerial_};
}

const SongEntry* SongList::EntryOf(SongHandle song) const {
    if (song.Serial == 0 || song.Slot >= slots_.size()) return nullptr;
    const Slot& slot = slots_[song.Slot];
    return slot.Serial == song.Serial ? slot.Entry : nullptr;
}
