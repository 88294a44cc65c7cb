#include "MusicManagment/database/intake/KnownSongs.h"

#include <algorithm>

#include "CommonRUKTools/Volumes.h"
#include "MusicManagment/database/ListGuards.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/media/CachePlace.h"

namespace {

QStringView NameOf(const QString& path) {
    return QStringView(path).sliced(path.lastIndexOf(u'/') + 1);
}

std::size_t Key(const QString& path) {
    return qHash(NameOf(path));
}

}  // namespace

bool KnownSongs::Contains(const QString& path, const QString& stored) {
    if (database_.Contains(path) || database_.Contains(stored)) return true;
    if (IsCdPath(path)) return false;
    if (!isIndexed_) IndexNames();
    const auto [from, to] = byName_.equal_range(Key(path));
    // A song may have been removed since.
    return std::any_of(from, to, [&](const auto& row) {
        return IsSameFile(row.second.Path, path) && database_.Contains(row.second.Stored);
    });
}

void KnownSongs::Add(const QString& path, const QString& stored) {
    if (isIndexed_) byName_.emplace(Key(path), Known{path, stored});
}

void KnownSongs::AddToIndex(const TID3Tag& song) {
    const QString& stored = song.FileName;
    if (!IsCdPath(stored)) return Add(stored, stored);
    const Volume* volume = CurrentVolumes().WithSerial(SerialOfCdPath(stored));
    if (volume != nullptr) Add(FileAt(volume->MountPoint, stored), stored);
}

// They lie where songs lie, and are none.
void KnownSongs::IndexCopies() {
    for (const auto& notes : {database_.Side().Rows(kCacheSection), OwnFiles(database_)})
        for (const auto& [song, copy] : notes)
            Add(copy, song);
}

// Only once a path is met that is not known as it stands.
void KnownSongs::IndexNames() {
    constexpr std::size_t kSongsPerTurn = 16'384;
    const BusyGuard unchanged(database_);
    isIndexed_ = true;
    byName_.reserve(static_cast<std::size_t>(database_.Count()));
    IndexCopies();
    std::size_t done = 0;
    for (const auto& song : database_.Songs()) {
        AddToIndex(*song);
        // A wish to stop is met by whoever goes on.
        if (++done % kSongsPerTurn == 0) database_.Progress({.Type = ptAddSongs}, false, false);
    }
}

std::optional<FolderIdentity> KnownSongs::FolderOf(const QString& path) {
    const QString folder = path.left(path.lastIndexOf(u'/') + 1);
    const auto known = folders_.constFind(folder);
    return known != folders_.constEnd() ? *known : *folders_.insert(folder, IdentifyFolder(folder));
}

bool KnownSongs::IsSameFile(const QString& a, const QString& b) {
    if (NameOf(a) != NameOf(b)) return false;
    const auto folder = FolderOf(a);
    return folder && folder == FolderOf(b);
}
