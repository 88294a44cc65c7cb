#include "MusicManagment/database/songfiles/SongUpdates.h"

#include <QFileInfo>
#include <QSet>
#include <algorithm>

#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/FileWork.h"
#include "MusicManagment/database/BannList.h"
#include "MusicManagment/database/Progress.h"
#include "MusicManagment/database/journal/FileBatch.h"
#include "MusicManagment/database/songfiles/RenameTarget.h"
#include "MusicManagment/database/songfiles/TagPlans.h"

using namespace Qt::StringLiterals;

namespace {

// What a song takes in the journal as a rule: its old tag, and its record twice.
constexpr qint64 kJournalBytesASong = 8192;

enum class Collision { RemoveTarget = 0, RemoveSource = 1, Cancel = 2 };

Collision AskAboutCollision(const QString& target) {
    const QString name = target.mid(LastSeparator(target) + 1);
    return static_cast<Collision>(
        UserDialogs().Ask({.Text = u"Die Datei "_s + name + u" existiert bereits."_s,
                           .Buttons = {u"Ziel löschen"_s, u"Quelle löschen"_s, u"Abbrechen"_s},
                           .Cancel = static_cast<int>(Collision::Cancel)}));
}

// Where the journal cannot hold the batch it runs without one, if the user agrees.
Journal* JournalFor(std::size_t songs) {
    Journal* journal = CurrentJournal();
    if (journal == nullptr || journal->FitsBatch(static_cast<qint64>(songs) * kJournalBytesASong))
        return journal;
    const QString question = u"Der Platz reicht nicht, um diesen Vorgang später rückgängig zu machen ("_s +
                             SongCountText(songs) + u")."_s;
    if (!UserDialogs().Confirm(question, u"Trotzdem ausführen"_s)) throw EAbort();
    return nullptr;
}

// One command that changes songs, from its first to its last.
class SongChanges {
 public:
    SongChanges(TMusicDatabase& database, const QString& caption, const QString& progress, std::size_t count)
        : database_(database),
          run_(std::in_place, database, progress),
          count_(count),
          batch_(JournalFor(count), &database, caption) {}

    // False when the user stopped.
    bool Next() {
        result_.Stopped = result_.Stopped || database_.Progress({.Cur = static_cast<qint64>(taken_),
                                                                 .Max = static_cast<qint64>(count_)});
        ++taken_;
        return !result_.Stopped;
    }

    void Update(const SongUpdate& update, TagPlans& plans, Renaming renaming) {
        const TID3Tag* song = database_.Songs().Find(update.Song);
        if (song == nullptr) return;
        const TID3Tag before = *song;
        SongItem item{.Song = update.Song, .Record = RecordAfter(update, before)};
        try {
            if (auto change = plans.Take(item.Record)) {
                item.Steps.Patch(before.FileName, std::move(change->Patch), change->Before);
                ++item.Count;
            }
        } catch (const EStreamError& error) {
            result_.Failed << before.FileName + u": "_s + error.Message();
            return;
        }
        if (item.Record != before) item.ChangeFrom(before);
        const QString target = renaming == Renaming::BySettings
                                   ? RenameTarget(database_, before.FileName, item.Record)
                                   : before.FileName;
        MoveTo(std::move(item), target);
    }

    void Move(SongHandle song, const QString& target) {
        if (const TID3Tag* record = database_.Songs().Find(song))
            MoveTo({.Song = song, .Record = *record}, target);
    }

    void Discard(SongHandle song, bool banned) {
        const TID3Tag* found = database_.Songs().Find(song);
        if (found == nullptr) return;
        SongItem item{.Song = song, .Record = *found};
        if (banned) item.Steps.Ban(BanEntry(*found));
        const bool hasFile = !IsCdPath(found->FileName) && StateOf(found->FileName).Exists();
        TakeOut(std::move(item), hasFile, banned);
    }

    void Replace(const SongReplacement& songs) {
        // What goes stands for nothing, and what stands for another stays.
        const bool isTaken = dropped_.contains(songs.Kept.Slot) || kept_.contains(songs.Dropped.Slot) ||
                             dropped_.contains(songs.Dropped.Slot);
        if (isTaken) return;
        // The plays of a song count once those before have been added.
        if (kept_.contains(songs.Kept.Slot)) batch_.Settle();
        const TID3Tag* kept = database_.Songs().Find(songs.Kept);
        const TID3Tag* dropped = database_.Songs().Find(songs.Dropped);
        if (kept == nullptr || dropped == nullptr || kept == dropped) return;
        if (!IsCdPath(kept->FileName) && !StateOf(kept->FileName).Exists()) {
            result_.Failed << dropped->FileName + u": Die Datei, die bleiben soll, fehlt: "_s +
                                  kept->FileName;
            return;
        }
        kept_.insert(songs.Kept.Slot);
        dropped_.insert(songs.Dropped.Slot);
        SongItem item{.Song = songs.Dropped, .Record = *dropped, .ReplacedBy = kept->FileName};
        if (dropped->PlayCount > 0) {
            TID3Tag played = *kept;
            played.PlayCount += std::min(dropped->PlayCount, ~quint32{0} - played.PlayCount);
            item.Gain = {*kept, std::move(played)};
        }
        const bool hasFile = !IsCdPath(dropped->FileName) && StateOf(dropped->FileName).Exists() &&
                             !IsSameFile(dropped->FileName, kept->FileName);
        TakeOut(std::move(item), hasFile, false);
    }

    void Substitute(const SongSubstitute& other) {
        const TID3Tag* song = database_.Songs().Find(other.Song);
        if (song == nullptr || song->FileName != other.Source || !StateOf(other.File).Exists()) return;
        const TID3Tag before = *song;
        SongItem item{.Song = other.Song, .Record = RecordWithSound(before, other)};
        const auto restore = Release(other.Source);
        item.Steps.Trash(other.Source).Record(before, item.Record);
        item.Count = 2;
        Add(std::move(item));
        // The other file may get the very name that this step has made free.
        batch_.Settle();
        const TID3Tag* after = database_.Songs().Find(other.Song);
        if (after != nullptr && after->FileName == other.File)
            MoveTo({.Song = other.Song, .Record = *after}, NameAfter(other, *after));
        if (!restore) return;
        batch_.Settle();
        after = database_.Songs().Find(other.Song);
        restore(after != nullptr ? after->FileName : other.Source);
    }

    // When everything is done that was to be: files that no song has got.
    void RemoveUnused(const std::vector<SongSubstitute>& substitutes) {
        batch_.Settle();
        for (const SongSubstitute& other : substitutes)
            if (StateOf(other.Source).Exists() && !database_.Contains(other.File)) RemoveUnused(other.File);
    }

    BatchResult Finish() {
        batch_.Settle();
        run_.reset();  // saving is a run of its own
        database_.SaveAfterCommand();
        batch_.Finish();
        if (!replaced_.isEmpty()) database_.Events().Superseded.Tell(replaced_);
        result_.Changed = static_cast<int>(changed_.size());
        return std::move(result_);
    }

 private:
    // What is to happen with one song.
    struct SongItem {
        SongHandle Song{};
        TID3Tag Record{};  // as it is to be
        FileItem Steps{};
        int Count = 0;         // of the steps before a move
        QString Target{};      // of the move; empty without one
        QString ReplacedBy{};  // path of the song that stands for one that goes
        RecordChange Gain{};   // of that song

        void ChangeFrom(const TID3Tag& before) {
            Steps.Record(before, Record);
            ++Count;
        }
    };

    // The file, where there is one that goes, and the song; the file is let go of before.
    void TakeOut(SongItem item, bool hasFile, bool banned) {
        const QString path = item.Record.FileName;
        const auto released = Release(path);
        if (hasFile) item.Steps.Trash(path, banned);
        item.Steps.Record(item.Record, std::nullopt);
        if (item.Gain.After) item.Steps.Record(item.Gain.Before, item.Gain.After);
        item.Count = 1;
        Add(std::move(item));
        if (!released) return;
        batch_.Settle();
        released(path);
    }

    static bool IsSameFile(const QString& a, const QString& b) {
        const QString file = QFileInfo(a).canonicalFilePath();
        return !file.isEmpty() && file == QFileInfo(b).canonicalFilePath();
    }

    void Add(SongItem item) {
        if (item.Count == 0 && item.Target.isEmpty()) return;
        item.Steps.Then([this, song = item.Song, path = item.Record.FileName, target = item.Target,
                         count = item.Count, by = item.ReplacedBy](const ItemResult& done) {
            if (done.StepsDone > 0) changed_.insert(song.Slot);
            if (!by.isEmpty() && done.IsComplete()) replaced_.insert(path, by);
            if (!target.isEmpty() && done.IsComplete()) ++result_.Renamed;
            if (done.IsComplete()) return;
            const bool failedToMove = !target.isEmpty() && done.StepsDone >= count;
            result_.Failed << (failedToMove ? u"Kann die Datei "_s + path + u" nicht nach "_s + target +
                                                  u" verschieben. "_s + done.Message
                                            : path + u": "_s + done.Message);
        });
        batch_.Add(std::move(item.Steps));
    }

    static TID3Tag RecordWithSound(const TID3Tag& song, const SongSubstitute& other) {
        TID3Tag record = song;
        record.FileName = other.File;
        record.MPEGLayer = other.Sound.MPEGLayer;
        record.Length = other.Sound.Length;
        record.BitRate = other.Sound.BitRate;
        record.SampleRate = other.Sound.SampleRate;
        record.ChannelMode = other.Sound.ChannelMode;
        record.Emphasis = other.Sound.Emphasis;
        record.Private = other.Sound.Private;
        record.Protected = other.Sound.Protected;
        record.Copyrighted = other.Sound.Copyrighted;
        record.Original = other.Sound.Original;
        record.Padding = other.Sound.Padding;
        record.FrameSize = other.Sound.FrameSize;
        return record;
    }

    // The name of the song's file with the ending of the other one.
    static QString NameInsteadOf(const SongSubstitute& other) {
        const QString ending = other.File.mid(other.File.lastIndexOf(u'.'));
        const qsizetype dot = other.Source.lastIndexOf(u'.');
        return (dot > LastSeparator(other.Source) ? other.Source.left(dot) : other.Source) + ending;
    }

    // By the rules for names. Another file that has the song's own name is not asked about: the number that
    // tells the two apart stays.
    QString NameAfter(const SongSubstitute& other, const TID3Tag& record) {
        const QString own = NameInsteadOf(other);
        const QString name = RenameTarget(database_, own, record);
        return name == own && IsTaken(own) ? record.FileName : name;
    }

    void RemoveUnused(const QString& file) {
        try {
            RemoveIfThere(file);
        } catch (const EStreamError& error) {
            result_.Failed << error.Message();
        }
    }

    // Adds the item and what takes the song to its target.
    void MoveTo(SongItem item, const QString& target) {
        const QString path = item.Record.FileName;
        if (IsCdPath(path) || target.compare(path, Qt::CaseInsensitive) == 0) return Add(std::move(item));
        const auto restore = Release(path);
        if (!restore && !IsTaken(target)) return AddMove(std::move(item), target);
        // The question comes when tag and record are written, which stay whatever the answer is.
        SongItem move{.Song = item.Song, .Record = item.Record};
        Add(std::move(item));
        batch_.Settle();
        if (!IsTaken(target) || ClearTarget(move, target)) {
            const SongHandle song = move.Song;
            AddMove(std::move(move), target);
            batch_.Settle();
            if (const TID3Tag* record = database_.Songs().Find(song); restore && record != nullptr)
                return restore(record->FileName);
        }
        if (restore) restore(path);
    }

    void AddMove(SongItem item, const QString& target) {
        TID3Tag moved = item.Record;
        moved.FileName = target;
        item.Steps.Move(item.Record.FileName, target).Record(item.Record, moved);
        item.Target = target;
        targets_.insert(target);
        Add(std::move(item));
    }

    // An earlier song of this command may be on its way there.
    bool IsTaken(const QString& target) {
        if (targets_.contains(target)) batch_.Settle();
        return StateOf(target).Exists();
    }

    // False when the song does not move.
    bool ClearTarget(const SongItem& item, const QString& target) {
        switch (AskAboutCollision(target)) {
            case Collision::RemoveTarget:
                return RemoveTarget(item, target);
            case Collision::RemoveSource:
                Discard(item.Song, false);
                return false;
            case Collision::Cancel:
                break;
        }
        result_.Stopped = true;
        return false;
    }

    bool RemoveTarget(const SongItem& item, const QString& target) {
        const TID3Tag* there = database_.Songs().Find(target);
        if (there == nullptr) {
            result_.Failed << item.Record.FileName + u": Kann den Eintrag "_s + target +
                                  u" nicht (mehr) finden."_s;
            return false;
        }
        Discard(database_.Songs().HandleOf(*there), false);
        batch_.Settle();
        return !StateOf(target).Exists();
    }

    // Has the player let go of the file; the result gives it back, under the path that it has then. Empty
    // where nobody holds it.
    std::function<void(const QString& path)> Release(const QString& path) {
        return database_.OnReleaseFile ? database_.OnReleaseFile(path) : nullptr;
    }

    TMusicDatabase& database_;
    std::optional<ProgressRun> run_;
    BatchResult result_;
    QSet<QString> targets_;
    QSet<quint32> changed_;  // songs, by slot
    QSet<quint32> kept_;     // instead of others, by slot
    QSet<quint32> dropped_;
    PathChanges replaced_;
    std::size_t count_;
    std::size_t taken_ = 0;
    FileBatch batch_;  // the last one: as it goes it tells what came of its items
};

QString ProgressText(const QString& progress, const QString& caption) {
    return progress.isEmpty() ? caption : progress;
}

}  // namespace

BatchResult UpdateSongs(TMusicDatabase& database, const QString& caption,
                        const std::vector<SongUpdate>& updates, Renaming renaming, const QString& progress) {
    SongChanges changes(database, caption, ProgressText(progress, caption), updates.size());
    TagPlans plans(database, updates);
    for (const SongUpdate& update : updates) {
        if (!changes.Next()) break;
        plans.Next();
        changes.Update(update, plans, renaming);
    }
    return changes.Finish();
}

BatchResult MoveSongs(TMusicDatabase& database, const QString& caption, const std::vector<SongMove>& moves) {
    SongChanges changes(database, caption, caption, moves.size());
    for (const SongMove& move : moves) {
        if (!changes.Next()) break;
        changes.Move(move.Song, move.Target);
    }
    return changes.Finish();
}

BatchResult DiscardSongs(TMusicDatabase& database, const QString& caption,
                         const std::vector<SongHandle>& songs, Banning banning) {
    SongChanges changes(database, caption, caption, songs.size());
    for (const SongHandle song : songs) {
        if (!changes.Next()) break;
        changes.Discard(song, banning == Banning::Banned);
    }
    return changes.Finish();
}

BatchResult ReplaceSongs(TMusicDatabase& database, const QString& caption,
                         const std::vector<SongReplacement>& replacements) {
    SongChanges changes(database, caption, caption, replacements.size());
    for (const SongReplacement& songs : replacements) {
        if (!changes.Next()) break;
        changes.Replace(songs);
    }
    return changes.Finish();
}

BatchResult SubstituteFiles(TMusicDatabase& database, const QString& caption,
                            const std::vector<SongSubstitute>& substitutes) {
    SongChanges changes(database, caption, caption, substitutes.size());
    for (const SongSubstitute& other : substitutes) {
        if (!changes.Next()) break;
        changes.Substitute(other);
    }
    changes.RemoveUnused(substitutes);
    return changes.Finish();
}

SongIndex UpdateSongEntry(TMusicDatabase& database, SongIndex index, const TID3Tag& info, bool rename) {
    if (index < 0 || index >= database.Count()) return -1;
    const SongHandle song = database.Songs().HandleOf(index);
    const SongUpdate update{.Song = song, .Basis = database.Song(index), .Record = info};
    const BatchResult result =
        UpdateSongs(database, u"1 Tag"_s, {update}, rename ? Renaming::BySettings : Renaming::Never);
    if (!result.Failed.isEmpty()) UserDialogs().ShowMessage(MessageKind::Error, result.Failed.join(u'\n'));
    if (result.Stopped) throw EAbort();
    return database.Songs().PositionOf(song);
}
