#include "MusicManagment/database/SongList.h"

#include <algorithm>
#include <utility>

void SongList::Append(Entry entry) {
    if (paths_) paths_->insert(entry.get());
    entries_.append(std::move(entry));
}

void SongList::Set(SongIndex index, TID3Tag record) {
    TID3Tag& target = *entries_[static_cast<std::size_t>(index)];
    if (!paths_ || target.FileName == record.FileName) {
        target = std::move(record);
        return;
    }
    Unindex(&target);
    target = std::move(record);
    paths_->insert(&target);
}

void SongList::Remove(SongIndex index) {
    const auto at = static_cast<std::size_t>(index);
    if (paths_) Unindex(entries_[at].get());
    entries_.removeAt(at);
}

void SongList::Move(SongIndex from, SongIndex to) {
    Entry entry = std::move(entries_[static_cast<std::size_t>(from)]);
    entries_.removeAt(static_cast<std::size_t>(from));
    entries_.insert(static_cast<std::size_t>(to), std::move(entry));
}

void SongList::Clear() {
    paths_.reset();
    entries_.clear();
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

SongIndex SongList::PositionOf(const TID3Tag* record) const {
    SongIndex index = 0;
    for (const Entry& entry : entries_) {
        if (entry.get() == record) return index;
        ++index;
    }
    return -1;
}

void SongList::Unindex(const TID3Tag* record) {
    const auto [first, last] = paths_->equal_range(record);
    const auto found = std::find(first, last, record);
    if (found != last) paths_->erase(found);
}
