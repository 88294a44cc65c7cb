#include "MusicManagment/database/intake/UpdateFolders.h"

#include <algorithm>

#include "MusicManagment/database/MusicManagment.h"

namespace {

QString WithSeparator(const QString& folder) {
    return folder.endsWith(u'/') ? folder : folder + u'/';
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
    if (remembered == database.UpdateFolders()) return;
    database.SetUpdateFolders(remembered);
    database.SetModified(true);
}
