#include "MusicManagment/playlist/PlayList.h"
#include "MusicManagment/playlist/SongPlayer.h"

// Songs of the database get other paths, or others stand for them, and the list goes along.

namespace {

bool Follow(QString& name, const PathChanges& renamed) {
    const auto now = renamed.constFind(name);
    if (now == renamed.constEnd()) return false;
    name = *now;
    return true;
}

}  // namespace

void TPlayList::FollowRenamed(const PathChanges& renamed) {
    const std::vector<int> positions = entries_.Rename(renamed);
    for (const int index : positions)
        if (auto record = FindRecord(NameAt(index), -1)) entries_.SetRecord(index, *std::move(record));
    for (RememberedEntry& entry : history_)
        Follow(entry.Name, renamed);
    Follow(currentFile_, renamed);  // unless it is a copy
    const bool plays = Follow(current_.Name, renamed);

    // The standard file is written at the end of the program in any case.
    const bool hasOwnFile = !playListFileName_.isEmpty() && playListFileName_ != standardFileName_;
    if (!positions.empty() && hasOwnFile) SetModified(true);
    for (const int index : positions)
        if (index < Count()) events_.Changed.Tell(index);
    if (!plays) return;
    if (player_ != nullptr) player_->RedrawPanel();
    events_.CurrentChanged.Tell();
}
