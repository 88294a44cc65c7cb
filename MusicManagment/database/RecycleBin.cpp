#include "MusicManagment/database/RecycleBin.h"

#include <QDir>
#include <QFileInfo>
#include <QStorageInfo>

#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/Trash.h"
#include "MusicManagment/database/SongTypes.h"

using namespace Qt::StringLiterals;

namespace {

// A file of the same name that is there already is not replaced: the move fails.
bool MoveToOwnFolder(const QString& path) {
    const QDir folder(
        QDir(QStorageInfo(QFileInfo(path).absolutePath()).rootPath()).filePath(kOwnRecycleFolder.toString()));
    if (!folder.mkpath(u"."_s)) return false;
    return QFile::rename(path, folder.filePath(QFileInfo(path).fileName()));
}

}  // namespace

bool MoveToRecycleBin(const QString& path, bool banned) {
    if (path.isEmpty() || IsCdPath(path)) return true;
    if (CurrentTrash().Take(path)) return true;
    if (MoveToOwnFolder(path)) return true;
    if (banned)
        UserDialogs().ShowMessage(MessageKind::Error, u"Kann die in der Bann-Liste eingetragene Datei "_s +
                                                          path + u" nicht in den Papierkorb verschieben."_s);
    else
        UserDialogs().ShowMessage(MessageKind::Error,
                                  u"Kann die Datei "_s + path + u" nicht in den Papierkob verschieben."_s);
    return false;
}
