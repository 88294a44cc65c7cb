#include "app/ShownFollowers.h"

#include <utility>

#include "app/views/WindowSettings.h"

void ShownFollowers::Begin(std::vector<QString> songs) {
    End();
    if (onlyThisSong_) return;
    songs_ = std::move(songs);
    renaming_ = list_.MusicDatabase()->Events().Renamed.Subscribe(
        [this](const PathChanges& renamed) { FollowRenamed(renamed); });
    waiting_ = next_ = 1;
    QueueNext();
}

void ShownFollowers::End() {
    for (; waiting_ < next_; ++waiting_)
        list_.Dequeue(list_.IndexOf(songs_[waiting_]));
    songs_.clear();
    renaming_.End();
    waiting_ = next_ = 0;
}

void ShownFollowers::FollowRenamed(const PathChanges& renamed) {
    for (QString& song : songs_)
        song = renamed.value(song, song);
}

// What has left the queue plays, or was passed over.
void ShownFollowers::FollowSong() {
    const QStringList queue = list_.Queue();
    while (waiting_ < next_ && !queue.contains(songs_[waiting_]))
        ++waiting_;
    QueueNext();
}

// Songs that have left the collection meanwhile are left out.
void ShownFollowers::QueueNext() {
    const TMusicDatabase* database = list_.MusicDatabase();
    for (; next_ < songs_.size() && next_ - waiting_ < kAhead; ++next_) {
        int entry = list_.IndexOf(songs_[next_]);
        const SongIndex song = entry < 0 ? database->IndexOf(songs_[next_]) : -1;
        if (song >= 0) {
            entry = list_.Count();
            list_.InsertSong(entry, song);
        }
        list_.Enqueue(entry);
    }
}

void ShownFollowers::LoadSettings(const TRWReg& settings) {
    onlyThisSong_ = ReadSetting(settings, WindowSettings::kPlayOnlyThisSong).value_or(onlyThisSong_);
}

void ShownFollowers::SaveSettings(TRWReg& settings) const {
    WriteSetting(settings, WindowSettings::kPlayOnlyThisSong, onlyThisSong_);
}
