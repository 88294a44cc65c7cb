#include "MusicManagment/database/batches/BurningBatch.h"

#include <QFileInfo>

#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/Progress.h"
#include "MusicManagment/database/media/CataloguedMedia.h"
#include "MusicManagment/database/songfiles/SongFinder.h"
#include "ReadMPEGHeader/DisplayTexts.h"

using namespace Qt::StringLiterals;

namespace {

// Whether songs that lie on a medium are taken: asked for each, or once for all.
class MediumPolicy {
 public:
    // Throws EAbort on cancel.
    bool Takes(const TID3Tag& song) {
        enum Answer { Yes, YesToAll, No, NoToAll, Cancel };
        if (forAll_) return *forAll_;
        const int answer = UserDialogs().Ask(
            {.Text = u"Die Datei "_s + ArtistAndTitle(song) +
                     u" befindet sich bereits auf einer CD. Soll sie dennoch in die Liste der zu brennenden "
                     "Dateien aufgenommen werden?"_s,
             .Buttons = {u"Ja"_s, u"Ja, alle"_s, u"Nein"_s, u"Nein, alle"_s, u"Abbrechen"_s},
             .Cancel = Cancel,
             .Default = Yes});
        if (answer == Cancel) throw EAbort();
        if (answer == YesToAll || answer == NoToAll) forAll_ = answer == YesToAll;
        return answer == Yes || answer == YesToAll;
    }

 private:
    std::optional<bool> forAll_;
};

QString WithNumber(const QString& path, int number) {
    const qsizetype dot = path.lastIndexOf(u'.');
    const qsizetype end = dot > path.lastIndexOf(u'/') ? dot : path.size();
    return path.left(end) + u" ("_s + QString::number(number) + u')' + path.mid(end);
}

class Preparation {
 public:
    Preparation(TMusicDatabase& database, const QString& folder, std::size_t total)
        : database_(database),
          folder_(folder.endsWith(u'/') ? folder : folder + u'/'),
          finder_(database),
          progress_{database, 0, static_cast<qint64>(total)} {}

    // Throws EAbort when the user stops in a question.
    void Take(SongHandle handle) {
        ++progress_.Number;
        const TID3Tag* found = database_.Songs().Find(handle);
        if (found == nullptr) return;
        const TID3Tag song = *found;  // a question lets time pass
        if (IsCdPath(song.FileName) && !policy_.Takes(song)) return;
        const QString file = finder_.Find(song.FileName);
        if (file.isEmpty()) {
            result_.Missing << PathForPeople(database_, song.FileName);
            return;
        }
        const QString target = FreeTarget(file);
        if (QFileInfo(target) == QFileInfo(file)) return;
        try {
            result_.Stopped = !CopyWhole(file, target, progress_);
            if (!result_.Stopped) ++result_.Done;
        } catch (const EStreamError& error) {
            result_.Failed << PathForPeople(database_, song.FileName) + u": "_s + error.Message();
        }
    }
    bool Stopped() const { return result_.Stopped; }
    void Stop() { result_.Stopped = true; }
    MediaBatchResult Finish() { return std::move(result_); }

 private:
    QString TargetOf(const QString& file) const {
        const QString& root = database_.MP3MoveRootDir();
        const bool isBelow = file.startsWith(root, Qt::CaseInsensitive);
        return folder_ + (isBelow ? file.mid(root.size()) : QFileInfo(file).fileName());
    }

    // One that no song of this batch has, also on a disc that does not tell letters by their case.
    QString FreeTarget(const QString& file) {
        const QString target = TargetOf(file);
        QString free = target;
        for (int number = 2; used_.contains(free.toCaseFolded()); ++number)
            free = WithNumber(target, number);
        used_.insert(free.toCaseFolded());
        return free;
    }

    TMusicDatabase& database_;
    QString folder_;
    SongFinder finder_;
    CopyProgress progress_;
    MediumPolicy policy_;
    QSet<QString> used_;
    MediaBatchResult result_;
};

}  // namespace

MediaBatchResult PrepareBurning(TMusicDatabase& database, const BatchSongs& songs, const QString& folder) {
    if (songs.IsEmpty() || !MayCopy(database, songs.Songs, folder)) return {.Stopped = !songs.IsEmpty()};
    const ProgressRun run(database, u"Bereite Brennen auf CD vor"_s);
    Preparation preparation(database, folder, songs.Songs.size());
    try {
        for (const SongHandle song : songs.Songs) {
            preparation.Take(song);
            if (preparation.Stopped()) break;
        }
    } catch (const EAbort&) {
        preparation.Stop();  // what was copied stays, and is told
    }
    return preparation.Finish();
}
