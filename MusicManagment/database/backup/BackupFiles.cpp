#include "MusicManagment/database/backup/BackupFiles.h"

#include <QFileInfo>
#include <algorithm>

#include "CommonRUKTools/AbsolutePath.h"
#include "CommonRUKTools/Volumes.h"
#include "MusicManagment/database/Progress.h"
#include "MusicManagment/database/intake/FolderWalk.h"
#include "MusicManagment/database/intake/ReadAhead.h"
#include "MusicManagment/database/media/CataloguedMedia.h"
#include "ReadMPEGHeader/SongFileKinds.h"

using namespace Qt::StringLiterals;

namespace {

// By the number that the collection has for it already.
quint32 NumberOf(const CataloguedMedia& media, const Volume& volume) {
    const quint32 known = media.SerialOf(volume);
    return known != 0 ? known : volume.Serials.front();
}

class Reader {
 public:
    Reader(TMusicDatabase& database, const BackupMedium& medium) : database_(database), medium_(medium) {}

    BackupContents Read(const QString& folder) {
        const QStringList files = Walk(folder);
        if (!contents_.Stopped) ReadFiles(files);
        return std::move(contents_);
    }

 private:
    QStringList Walk(const QString& folder) {
        QStringList files;
        FolderWalk walk({.IsWanted = &IsSongFile, .Progress = [this](const QString& path) {
                             return database_.Progress({.Type = ptReadBackupCd, .Description = path});
                         }});
        contents_.Stopped = !walk.Walk(folder, files);
        contents_.Unreadable = walk.Unreadable();
        return files;
    }

    void ReadFiles(const QStringList& paths) {
        const ReadOptions options = database_.AudioReadOptions();
        const auto isKnown = [this](const QString& path) { return database_.Contains(StoredPath(path)); };
        ReadAhead files(paths, options, isKnown);
        for (qsizetype i = 0; i < paths.size(); ++i) {
            const ProgressPoint point{
                .Cur = i, .Max = paths.size(), .Type = ptReadBackupCd, .Description = paths[i]};
            const QString& path = files.Next();
            const bool isThere = isKnown(path);
            const auto reading = isThere ? std::nullopt : files.Take([&] { return GoOn(point); });
            contents_.Stopped = !GoOn(point) || (!isThere && !reading);
            if (contents_.Stopped) return;
            if (isThere)
                ++contents_.Known;
            else
                Take(path, *reading);
        }
    }

    bool GoOn(const ProgressPoint& point) { return !database_.Progress(point); }

    void Take(const QString& path, const SongReading& reading) {
        if (!reading.Succeeded()) {
            contents_.Unreadable << path + u": "_s + reading.Failure();
        } else if (path.contains(u'\\')) {
            contents_.Unreadable << path +
                                        u": Ein umgekehrter Schrägstrich im Namen ist auf katalogisierten "
                                        "Datenträgern nicht möglich"_s;
        } else {
            BackupFile file{.Path = path, .Tag = reading.Tag, .Size = QFileInfo(path).size()};
            file.Tag.FileName = StoredPath(path);
            contents_.Files.push_back(std::move(file));
        }
    }

    QString StoredPath(const QString& path) const {
        const qsizetype root = medium_.MountPoint == u"/"_s ? 0 : medium_.MountPoint.size();
        return MakeCdPath(medium_.Serial, path.mid(root));
    }

    TMusicDatabase& database_;
    const BackupMedium& medium_;
    BackupContents contents_;
};

}  // namespace

BackupMedium BackupMediumOf(const TMusicDatabase& database, const QString& folder) {
    CurrentVolumes().Forget();
    const Volume* volume = CurrentVolumes().Holding(AbsolutePath(folder));
    if (volume == nullptr || volume->Serials.empty())
        throw EMusicDatabaseException(
            u"Der Datenträger hat keine Seriennummer und kann nicht katalogisiert werden: "_s + folder);
    const CataloguedMedia media(database);
    if (!volume->CanBeTakenAway() && !media.IsCatalogued(*volume))
        throw EMusicDatabaseException(
            u"Das ist kein Datenträger, der entfernt werden kann. Nehmen Sie seine Songs als gewöhnlichen "
            "Ordner auf: "_s +
            folder);
    return {.MountPoint = volume->MountPoint, .Label = volume->Label, .Serial = NumberOf(media, *volume)};
}

BackupContents ReadBackup(TMusicDatabase& database, const BackupMedium& medium, const QString& folder) {
    const ProgressRun run(database, u"Lese die Songs einer Backup-CD ein"_s);
    return Reader(database, medium).Read(AbsolutePath(folder));
}
