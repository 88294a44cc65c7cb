#include "MusicManagment/database/journal/RecordChanges.h"

#include <QHash>

#include "MusicManagment/database/CollectionEdit.h"
#include "MusicManagment/database/SongFields.h"

namespace {

// Collects what is to happen to each song, however many of the changes are about it.
class Application {
 public:
    Application(TMusicDatabase& database, Applying how) : database_(database), how_(how) {}

    void Take(const RecordChange& change) {
        if (change.Before && change.After) return Change(*change.Before, *change.After);
        if (change.Before) return Remove(*change.Before);
        if (change.After) Add(*change.After);
    }

    AppliedRecords Commit() {
        CollectionEdit edit(database_);
        for (const auto& [song, record] : changed_.asKeyValueRange())
            edit.Change(handles_[song], record);
        for (const SongHandle song : removed_)
            edit.Remove(song);
        for (const TID3Tag& record : added_)
            edit.Add(record, AddAs::Returning);
        result_.IsDone = edit.Commit();
        for (const SongEdit& done : edit.Done())
            if (done.After) result_.Songs << done.After->FileName;
        return result_;
    }

 private:
    // The song that has this path once everything so far has happened; nullptr when there is none.
    const TID3Tag* Find(const QString& path, SongHandle& handle) {
        if (const auto moved = nowAt_.find(path); moved != nowAt_.end()) {
            handle = *moved;
            return &changed_[handle.Slot];
        }
        const SongIndex index = database_.IndexOf(path);
        if (index < 0) return nullptr;
        handle = database_.Songs().HandleOf(index);
        if (changed_.contains(handle.Slot)) return nullptr;  // it has left this path
        return &database_.Song(index);
    }

    void Change(const TID3Tag& before, const TID3Tag& after) {
        SongHandle handle;
        // A song that has the new path is the one; another may have its old one by now.
        const bool newFirst = how_ == Applying::Again;
        const TID3Tag* song = Find(newFirst ? after.FileName : before.FileName, handle);
        if (song == nullptr) song = Find(newFirst ? before.FileName : after.FileName, handle);
        if (song == nullptr) {
            ++result_.LeftAlone;
            return;
        }
        const TID3Tag record = MergedChange(*song, before, after, MergeConflict::KeepsSong);
        nowAt_.remove(song->FileName);
        nowAt_.insert(record.FileName, handle);
        handles_.insert(handle.Slot, handle);
        changed_.insert(handle.Slot, record);
    }

    void Remove(const TID3Tag& record) {
        SongHandle handle;
        if (Find(record.FileName, handle) == nullptr) {
            ++result_.LeftAlone;
            return;
        }
        removed_.push_back(handle);
    }

    void Add(const TID3Tag& record) {
        SongHandle handle;
        if (Find(record.FileName, handle) != nullptr) {
            ++result_.LeftAlone;
            return;
        }
        added_.push_back(record);
    }

    TMusicDatabase& database_;
    Applying how_;
    QHash<QString, SongHandle> nowAt_;
    QHash<quint32, SongHandle> handles_;  // by slot
    QHash<quint32, TID3Tag> changed_;
    std::vector<SongHandle> removed_;
    std::vector<TID3Tag> added_;
    AppliedRecords result_;
};

}  // namespace

AppliedRecords ApplyRecords(TMusicDatabase& database, const std::vector<RecordChange>& changes,
                            Applying how) {
    Application application(database, how);
    for (const RecordChange& change : changes)
        application.Take(change);
    return application.Commit();
}

bool ApplyBans(TMusicDatabase& database, const std::vector<BanChange>& changes) {
    SortedTextList& list = database.BannList();
    bool changed = false;
    for (const BanChange& change : changes) {
        const int at = list.IndexOf(change.Entry);
        if (change.Added == (at >= 0)) continue;
        if (change.Added)
            list.Insert(change.Entry);
        else
            list.RemoveAt(at);
        changed = true;
    }
    return changed;
}
