#include "MusicManagment/playlist/SongCopies.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>

#include "CommonRUKTools/PrivateFolder.h"

using namespace Qt::StringLiterals;

namespace {

// What cannot be removed (on Windows a song that still plays) stays until the next time.
void RemoveFile(const QFileInfo& file) {
    const QString path = file.filePath();
    if (QFile::remove(path) || file.isSymLink()) return;
    QFile::setPermissions(path, QFile::ReadOwner | QFile::WriteOwner);
    QFile::remove(path);
}

void EmptyFolder(const QDir& folder, const QString& but) {
    const auto files = folder.entryInfoList(QDir::Files | QDir::Hidden | QDir::System);
    for (const QFileInfo& file : files)
        if (file.filePath() != but) RemoveFile(file);
}

}  // namespace

QString CopyForPlaying(const QString& path, const QString& playing) {
    const QDir folder(QDir::tempPath() + u"/Tunestead Song-Copies"_s);
    if (!MakePrivateFolder(folder.path())) return path;
    // A list can name a copy; emptying the folder would take it away.
    const QFileInfo song(path);
    if (song.canonicalPath() == folder.canonicalPath()) return path;
    EmptyFolder(folder, playing);
    QString copy = folder.filePath(song.fileName());
    if (copy == playing) copy = folder.filePath(u"2 "_s + song.fileName());
    return QFile::copy(path, copy) ? copy : path;
}
