#include "MusicManagment/database/RecycleBin.h"

#include <QDir>
#include <QFileInfo>
#include <QStandardPaths>
#include <QStorageInfo>

#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/FileChange.h"
#include "CommonRUKTools/FileSource.h"
#include "CommonRUKTools/Trash.h"
#include "MusicManagment/database/SongTypes.h"

using namespace Qt::StringLiterals;

namespace {

// Empty when it cannot be made.
QString OwnFolder(const QString& path) {
    const QString volume = QStorageInfo(QFileInfo(path).absolutePath()).rootPath();
    const QString data = QStandardPaths::writableLocation(QStandardPaths::GenericDataLocation);
    for (const QString& place : {volume, data}) {
        const QDir folder(QDir(place).filePath(kOwnRecycleFolder.toString()));
        if (folder.mkpath(u"."_s) && QFileInfo(folder.path()).isWritable()) return folder.path();
    }
    return {};
}

bool IsInOwnFolder(const QString& place) {
    return QFileInfo(QFileInfo(place).absolutePath()).fileName() == kOwnRecycleFolder;
}

QString OwnPlaceFor(const QString& path) {
    const QString folder = OwnFolder(path);
    return folder.isEmpty() ? QString() : QDir(folder).filePath(QFileInfo(path).fileName());
}

// A file of the same name that is there already is not replaced: the move fails.
bool Moved(const QString& from, const QString& to) {
    try {
        MoveFile(from, to);
        return true;
    } catch (const EHalfDone&) {
        throw;
    } catch (const EStreamError&) {
        return false;
    }
}

}  // namespace

QString RecycleFailure(const QString& path, bool banned) {
    if (banned)
        return u"Kann die in der Bann-Liste eingetragene Datei "_s + path +
               u" nicht in den Papierkorb verschieben."_s;
    return u"Kann die Datei "_s + path + u" nicht in den Papierkob verschieben."_s;
}

bool MoveToRecycleBin(const QString& path, bool banned) {
    if (path.isEmpty() || IsCdPath(path)) return true;
    if (CurrentTrash().Take(path)) return true;
    const QString own = OwnPlaceFor(path);
    if (!own.isEmpty() && Moved(path, own)) return true;
    UserDialogs().ShowMessage(MessageKind::Error, RecycleFailure(path, banned));
    return false;
}

QString RecyclePlaceFor(const QString& path) {
    const QString place = CurrentTrash().PlaceFor(path);
    return place.isEmpty() ? OwnPlaceFor(path) : place;
}

bool MoveToRecyclePlace(const QString& path, const QString& place) {
    return IsInOwnFolder(place) ? Moved(path, place) : CurrentTrash().TakeTo(path, place);
}

bool BringBack(const QString& place, const QString& path) {
    return IsInOwnFolder(place) ? Moved(place, path) : CurrentTrash().Restore(place, path);
}
