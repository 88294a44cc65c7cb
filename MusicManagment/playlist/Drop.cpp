#include <QFileInfo>
#include <algorithm>

#include "CommonRUKTools/AbsolutePath.h"
#include "MusicManagment/database/FolderWalk.h"
#include "MusicManagment/database/Intake.h"
#include "MusicManagment/playlist/ListRecognition.h"
#include "MusicManagment/playlist/PlayList.h"
#include "MusicManagment/playlist/PlayListFiles.h"

// Files from outside become entries.

namespace {

QStringList SongsBelow(const QString& folder) {
    FolderWalk walk({.IsWanted = [](const QString& name) { return IsSongFile(name); }});
    QStringList files;
    walk.Walk(folder, files);
    return files;
}

// A playlist stands for its entries, a folder for the songs in it; what is not there for nothing.
std::vector<PlayListEntry> Expanded(const QString& path) {
    const QFileInfo info(path);
    if (info.isDir()) {
        std::vector<PlayListEntry> entries;
        for (const QString& file : SongsBelow(path))
            entries.push_back({.Name = file});
        return entries;
    }
    if (!info.isFile()) return {};
    if (IsPlayListName(path)) return ReadPlayList(path);
    return {{.Name = path}};
}

}  // namespace

std::vector<PlayListEntry> TPlayList::EntriesFor(const QStringList& paths) const {
    std::vector<PlayListEntry> entries;
    for (const QString& path : paths)
        for (PlayListEntry& entry : Expanded(AbsolutePath(path))) {
            const bool isSong = IsSongFile(entry.Name) || (database_ && database_->Contains(entry.Name));
            if (!entry.Record && isSong) entry.Record = FindRecord(entry.Name, -1);
            entries.push_back(std::move(entry));
        }
    return entries;
}

int TPlayList::InsertFiles(int position, const QStringList& paths) {
    std::vector<PlayListEntry> entries = EntriesFor(paths);
    position = std::clamp(position, 0, Count());
    for (PlayListEntry& entry : entries)
        Insert(position++, std::move(entry));
    return static_cast<int>(entries.size());
}
