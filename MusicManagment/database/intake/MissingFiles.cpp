#include "MusicManagment/database/intake/MissingFiles.h"

#include <QDir>
#include <QFileInfo>
#include <QMap>

#include "CommonRUKTools/FileSource.h"
#include "MusicManagment/database/SongTypes.h"
#include "MusicManagment/database/intake/UpdateFolders.h"

namespace {

bool HasEntries(const QString& folder) {
    return !QDir(folder).isEmpty(QDir::AllEntries | QDir::NoDotAndDotDot | QDir::Hidden | QDir::System);
}

}  // namespace

MissingFiles::MissingFiles(const QStringList& updateFolders) {
    for (const QString& folder : updateFolders)
        (QFileInfo(folder).isDir() && HasEntries(folder) ? there_ : notThere_) << folder;
    outOfReach_ = QSet<QString>(notThere_.begin(), notThere_.end());
}

bool MissingFiles::IsThere(const QString& song) {
    if (IsCdPath(song)) return true;
    const QString folder = FolderOf(song);
    if (FileSource::Exists(song)) {
        living_.insert(folder);
        return true;
    }
    if (LiesBelow(song, notThere_)) return false;
    const Folder found = Look(folder);
    // Of a folder that the user has not named nobody knows where it has gone.
    if (found.Is == State::OutOfReach || (found.Is == State::Gone && !LiesBelow(song, there_)))
        outOfReach_.insert(found.Top);
    else
        missing_.push_back({song, folder});
    return false;
}

MissingFiles::Folder MissingFiles::Look(const QString& folder) {
    const auto known = folders_.constFind(folder);
    if (known != folders_.constEnd()) return *known;
    return *folders_.insert(folder, LookAtDisk(folder));
}

MissingFiles::Folder MissingFiles::LookAtDisk(const QString& folder) {
    const QFileInfo info(folder);
    if (info.isDir()) return {HasEntries(folder) ? State::There : State::OutOfReach, folder};
    if (info.isSymLink()) return {State::OutOfReach, folder};  // it leads to what is not plugged in
    const QString parent = FolderOf(folder);
    if (parent == folder) return {State::Gone, folder};
    const Folder above = Look(parent);
    return above.Is == State::There ? Folder{State::Gone, folder} : above;
}

QStringList MissingFiles::Single() const {
    QStringList songs;
    for (const auto& [song, folder] : missing_)
        if (living_.contains(folder)) songs << song;
    return songs;
}

std::vector<EmptiedFolder> MissingFiles::ByFolder() const {
    QMap<QString, QStringList> songsOf;
    for (const auto& [song, folder] : missing_)
        if (!living_.contains(folder)) songsOf[folders_.value(folder).Top] << song;
    std::vector<EmptiedFolder> folders;
    for (auto row = songsOf.cbegin(); row != songsOf.cend(); ++row)
        folders.push_back({row.key(), row.value()});
    return folders;
}

QStringList MissingFiles::OutOfReach() const {
    QStringList folders(outOfReach_.begin(), outOfReach_.end());
    folders.sort();
    return folders;
}
