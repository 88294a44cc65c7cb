#include "MusicManagment/database/batches/CacheBatch.h"

#include <QScopeGuard>
#include <algorithm>

#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/FileWork.h"
#include "MusicManagment/database/Progress.h"
#include "MusicManagment/database/batches/BatchFrame.h"
#include "MusicManagment/database/media/CachePlace.h"
#include "MusicManagment/database/media/CataloguedMedia.h"
#include "MusicManagment/database/songfiles/SongFinder.h"

using namespace Qt::StringLiterals;

namespace {

constexpr BatchTexts kCaching = {.All = u"Zwischenspeichern aller Songs",
                                 .Marked = u"Zwischenspeichern aller markierter Songs",
                                 .One = u"Zwischenspeichern aller markierter Songs"};
constexpr BatchTexts kDropping = {.All = u"Zwischenspeicherung aller Songs entfernen",
                                  .Marked = u"Zwischenspeicherung aller markierter Songs entfernen",
                                  .One = u"Zwischenspeicherung aller markierter Songs entfernen"};

// A crash forgets at most so many copies.
constexpr int kCopiesPerSave = 16;

bool MayGoOn(const TMusicDatabase& database, const QString& question) {
    return database.QuietBatches() || UserDialogs().AskYesNo(question);
}

// Those on media that have no copy, the songs of a medium one after the other.
std::vector<SongHandle> WithoutCopy(const TMusicDatabase& database, const BatchSongs& songs) {
    std::vector<SongHandle> wanted;
    for (const SongHandle handle : songs.Songs) {
        const TID3Tag* song = database.Songs().Find(handle);
        if (song != nullptr && IsCdPath(song->FileName) && CachedCopy(database, song->FileName).isEmpty())
            wanted.push_back(handle);
    }
    std::ranges::stable_sort(wanted, {}, [&](SongHandle handle) {
        return SerialOfCdPath(database.Songs().Find(handle)->FileName);
    });
    return wanted;
}

class Cacher {
 public:
    Cacher(TMusicDatabase& database, std::size_t total)
        : database_(database), finder_(database), progress_{database, 0, static_cast<qint64>(total)} {}

    // False when the batch is to end.
    bool Cache(SongHandle handle) {
        ++progress_.Number;
        const TID3Tag* found = database_.Songs().Find(handle);
        if (found == nullptr) return true;
        const TID3Tag song = *found;  // a question lets time pass
        const QString file = finder_.Find(song.FileName, {.UseCache = false});
        if (file.isEmpty()) {
            result_.Missing << PathForPeople(database_, song.FileName);
            return true;
        }
        const QString place = CachePlace(database_, song);
        // Two songs may have one place.
        if (FileSource::Exists(place)) return true;
        try {
            result_.Stopped = !CopyWhole(file, place, progress_);
        } catch (const EStreamError& error) {
            result_.Failed << PathForPeople(database_, song.FileName) + u": "_s + error.Message();
            result_.Stopped = !MayGoOn(database_, u"Die Datei "_s + file +
                                                      u" konnte nicht gecachet werden. "
                                                      "Trotzdem fortfahren?"_s);
            return !result_.Stopped;
        }
        if (!result_.Stopped) Note(song.FileName, place);
        return !result_.Stopped;
    }

    MediaBatchResult Finish() {
        database_.Side().Save();
        return std::move(result_);
    }

 private:
    void Note(const QString& song, const QString& copy) {
        database_.Side().Add(kCacheSection, {song, copy});
        if (++result_.Done % kCopiesPerSave == 0) database_.Side().Save();
    }

    TMusicDatabase& database_;
    SongFinder finder_;
    CopyProgress progress_;
    MediaBatchResult result_;
};

// The notes about the songs of a batch.
std::vector<SideRow> NotesOf(const TMusicDatabase& database, const BatchSongs& songs) {
    if (songs.Range == BatchRange::All) return database.Side().Rows(kCacheSection);
    std::vector<SideRow> notes;
    for (const SongHandle handle : songs.Songs)
        if (const TID3Tag* song = database.Songs().Find(handle))
            for (const QString& copy : database.Side().Values(kCacheSection, song->FileName))
                notes.push_back({song->FileName, copy});
    return notes;
}

// The player lets go of a copy that it plays, and stops where that is gone.
void RemoveCopy(const TMusicDatabase& database, const QString& copy) {
    if (!FileSource::Exists(copy)) return;
    const auto takeUp = database.OnReleaseFile ? database.OnReleaseFile(copy) : nullptr;
    const auto giveBack = qScopeGuard([&] {
        if (takeUp) takeUp(copy);
    });
    RemoveIfThere(copy);
}

}  // namespace

MediaBatchResult CacheSongs(TMusicDatabase& database, const BatchSongs& songs) {
    const std::vector<SongHandle> wanted = WithoutCopy(database, songs);
    if (wanted.empty()) return {};
    MediaBatchResult result;
    if (!MayCopy(database, wanted, database.MP3MoveRootDir())) {
        result.Stopped = true;
        return result;
    }
    {
        const ProgressRun run(database, kCaching.Of(songs.Range));
        Cacher cacher(database, wanted.size());
        for (const SongHandle song : wanted)
            if (!cacher.Cache(song)) break;
        result = cacher.Finish();
    }
    database.Events().MediaChanged.Tell();
    return result;
}

MediaBatchResult DropCaches(TMusicDatabase& database, const BatchSongs& songs) {
    const std::vector<SideRow> notes = NotesOf(database, songs);
    MediaBatchResult result;
    {
        const ProgressRun run(database, kDropping.Of(songs.Range));
        const auto total = static_cast<qint64>(notes.size());
        for (qint64 i = 0; i < total && !result.Stopped; ++i) {
            const SideRow& note = notes[static_cast<std::size_t>(i)];
            result.Stopped = CopyProgress{database, i, total}.Reach(note.Value, 0, 0);
            if (result.Stopped) break;
            try {
                if (!database.Contains(note.Value)) RemoveCopy(database, note.Value);
                database.Side().Remove(kCacheSection, note);
                ++result.Done;
            } catch (const EStreamError& error) {
                result.Failed << error.Message();
                result.Stopped = !MayGoOn(database, u"Die Zwischenspeicherung "_s + note.Value +
                                                        u" konnte nicht gelöscht werden. "
                                                        "Trotzdem fortfahren?"_s);
            }
        }
        database.Side().Save();
    }
    database.Events().MediaChanged.Tell();
    return result;
}
