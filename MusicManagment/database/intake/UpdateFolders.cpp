#include "MusicManagment/database/intake/UpdateFolders.h"

#include <algorithm>

#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/media/CataloguedMedia.h"

namespace {

// The CD path of an update folder, of several where media take turns at one place.
const QString kSection = QStringLiteral("update-folder");

QString WithSeparator(const QString& folder) {
    return folder.endsWith(u'/') ? folder : folder + u'/';
}

// A folder that is not there now leaves what was noted of it.
void NoteMedia(TMusicDatabase& database) {
    const CataloguedMedia media(database);
    for (const QString& folder : database.UpdateFolders()) {
        const SideRow row{folder, media.StoredPath(folder)};
        if (!IsCdPath(row.Value) || database.Side().Contains(kSection, row)) continue;
        database.Side().Add(kSection, row);
        database.SetModified(true);
    }
}

QStringList PlacesOf(const TMusicDatabase& database, const QString& folder) {
    QStringList places;
    for (const QString& onMedium : database.Side().Values(kSection, folder))
        if (const Volume* volume = CurrentVolumes().WithSerial(SerialOfCdPath(onMedium)); volume != nullptr)
            places << FileAt(volume->MountPoint, onMedium);
    return places.isEmpty() ? QStringList(folder) : places;
}

}  // namespace

bool LiesBelow(const QString& path, const QStringList& folders) {
    return std::any_of(folders.begin(), folders.end(),
                       [&path](const QString& folder) { return path.startsWith(WithSeparator(folder)); });
}

QStringList MergeFolders(QStringList folders, const QStringList& more) {
    for (const QString& folder : more) {
        if (folders.contains(folder) || LiesBelow(folder, folders)) continue;
        folders.removeIf([&folder](const QString& other) { return LiesBelow(other, {folder}); });
        folders << folder;
    }
    return folders;
}

void RememberFolders(TMusicDatabase& database, const QStringList& folders) {
    const QStringList remembered = MergeFolders(database.UpdateFolders(), folders);
    if (remembered != database.UpdateFolders()) {
        database.SetUpdateFolders(remembered);
        database.SetModified(true);
    }
    if (database.ModernMedia()) NoteMedia(database);
}

QStringList FoldersToSearch(TMusicDatabase& database) {
    if (!database.ModernMedia()) return database.UpdateFolders();
    NoteMedia(database);
    QStringList places;
    for (const QString& folder : database.UpdateFolders())
        places = MergeFolders(std::move(places), PlacesOf(database, folder));
    return places;
}
