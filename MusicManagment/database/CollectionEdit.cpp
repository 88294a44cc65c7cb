#include "MusicManagment/database/CollectionEdit.h"

#include <algorithm>
#include <unordered_set>
#include <utility>

#include "MusicManagment/database/sorting/Sorting.h"

namespace {

// More changed songs than these are placed together: a place alone costs a search through the list, a place
// of many one walk over it.
constexpr std::size_t kPlacedSingly = 32;

// Whether a song still is what an edit made of it. Being played meanwhile is no change of it.
bool IsStill(const TID3Tag& song, const TID3Tag& made) {
    if (song.PlayCount == made.PlayCount) return song == made;
    TID3Tag compared = made;
    compared.PlayCount = song.PlayCount;
    return song == compared;
}

// Puts `moving`, which is in order, into `staying`, which is too; behind its equals.
std::vector<SongList::Entry> Merged(const SongOrder& order, std::vector<SongList::Entry> staying,
                                    std::vector<SongList::Entry> moving) {
    std::vector<SongList::Entry> merged;
    merged.reserve(staying.size() + moving.size());
    auto from = staying.begin();
    for (SongList::Entry& entry : moving) {
        const auto behind = std::upper_bound(from, staying.end(), entry,
                                             [&order](const SongList::Entry& a, const SongList::Entry& b) {
                                                 return CompareSongs(order, *a, *b) < 0;
                                             });
        std::move(from, behind, std::back_inserter(merged));
        merged.push_back(std::move(entry));
        from = behind;
    }
    std::move(from, staying.end(), std::back_inserter(merged));
    return merged;
}

}  // namespace

void CollectionEdit::Change(SongHandle song, TID3Tag record) {
    changes_.push_back({song, std::move(record)});
}

void CollectionEdit::Add(TID3Tag record, AddAs as) {
    additions_.push_back({std::move(record), as});
}

void CollectionEdit::Remove(SongHandle song) {
    removals_.push_back(song);
}

int CollectionEdit::TakeBack(const std::vector<SongEdit>& done) {
    int leftAlone = 0;
    for (auto edit = done.rbegin(); edit != done.rend(); ++edit) {
        const TID3Tag* song = database_.Songs().Find(edit->Song);
        if (!edit->After) {
            if (database_.Contains(edit->Before->FileName))
                ++leftAlone;
            else
                Add(*edit->Before, AddAs::Returning);
        } else if (song == nullptr || !IsStill(*song, *edit->After)) {
            ++leftAlone;
        } else if (!edit->Before) {
            Remove(edit->Song);
        } else {
            TID3Tag before = *edit->Before;
            before.PlayCount = std::max(before.PlayCount, song->PlayCount);
            Change(edit->Song, std::move(before));
        }
    }
    return leftAlone;
}

bool CollectionEdit::Commit() {
    if (!database_.TakesChanges()) return false;
    RemoveSongs();
    ChangeSongs();
    TellRenamed();
    AddSongs();
    return true;
}

void CollectionEdit::RemoveSongs() {
    for (const SongHandle song : std::exchange(removals_, {})) {
        const SongIndex index = database_.Songs().PositionOf(song);
        if (index >= 0) done_.push_back({song, database_.RemoveSong(index), std::nullopt});
    }
}

void CollectionEdit::ChangeSongs() {
    if (changes_.empty()) return;
    database_.EnsureSorted();
    if (changes_.size() > kPlacedSingly) return ChangeMany();
    for (Changing& change : std::exchange(changes_, {})) {
        const SongIndex index = database_.Songs().PositionOf(change.Song);
        if (index < 0) continue;
        TID3Tag before = database_.Song(index);
        const SongIndex place = database_.ChangeSong(index, std::move(change.Record));
        NoteChange(change.Song, std::move(before), database_.Song(place));
    }
}

// Each song changes where it stands; those that do not belong there any more are placed together.
void CollectionEdit::ChangeMany() {
    std::vector<SongHandle> misplaced;
    for (Changing& change : std::exchange(changes_, {})) {
        const SongIndex index = database_.Songs().PositionOf(change.Song);
        if (index < 0) continue;
        TID3Tag before = database_.PutRecord(index, std::move(change.Record));
        const TID3Tag after = database_.Song(index);
        if (CompareSongs(database_.Order(), before, after) != 0) misplaced.push_back(change.Song);
        database_.TellChanged(index, before);
        NoteChange(change.Song, std::move(before), after);
    }
    if (!misplaced.empty()) PlaceAgain(misplaced);
}

// A song that was to change twice has changed once.
void CollectionEdit::NoteChange(SongHandle song, TID3Tag before, TID3Tag after) {
    if (before.FileName != after.FileName) renamed_.emplace_back(song, before.FileName);
    const auto [known, isNew] = changedAt_.try_emplace(song.Slot, done_.size());
    if (isNew)
        done_.push_back({song, std::move(before), std::move(after)});
    else
        done_[known->second].After = std::move(after);
}

void CollectionEdit::TellRenamed() {
    PathChanges renamed;
    std::unordered_set<quint32> told;
    for (const auto& [song, path] : std::exchange(renamed_, {})) {
        const TID3Tag* record = database_.Songs().Find(song);
        const bool isFirst = told.insert(song.Slot).second;
        if (record != nullptr && isFirst && record->FileName != path) renamed.insert(path, record->FileName);
    }
    if (!renamed.isEmpty()) database_.Events().Renamed.Tell(renamed);
}

void CollectionEdit::PlaceAgain(const std::vector<SongHandle>& songs) {
    SongList& list = database_.songs_;
    const SongOrder& order = database_.Order();
    std::unordered_set<const TID3Tag*> records;
    for (const SongHandle song : songs)
        records.insert(list.Find(song));

    database_.Events().Reordering.Tell();
    auto entries = list.TakeAll();
    const auto firstMoving = std::stable_partition(
        entries.begin(), entries.end(),
        [&records](const SongList::Entry& entry) { return !records.contains(entry.get()); });
    std::vector<SongList::Entry> moving(std::make_move_iterator(firstMoving),
                                        std::make_move_iterator(entries.end()));
    entries.erase(firstMoving, entries.end());
    SortSongs(order, moving);
    list.PutAll(Merged(order, std::move(entries), std::move(moving)));
    database_.Events().Reordered.Tell();
}

void CollectionEdit::AddSongs() {
    for (Adding& addition : std::exchange(additions_, {})) {
        const SongIndex index = database_.AddEntry(QString(), std::move(addition.Record), addition.As);
        if (index >= 0)
            done_.push_back({database_.Songs().HandleOf(index), std::nullopt, database_.Song(index)});
    }
}
