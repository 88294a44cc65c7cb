#include "MusicManagment/database/backup/BackupTaking.h"

#include <QSet>
#include <algorithm>
#include <numeric>
#include <tuple>

#include "CommonRUKTools/Clock.h"
#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/FileSource.h"
#include "MusicManagment/database/Progress.h"
#include "MusicManagment/database/journal/FileBatch.h"
#include "MusicManagment/database/media/CachePlace.h"
#include "MusicManagment/database/media/CataloguedMedia.h"

using namespace Qt::StringLiterals;

namespace {

using Kind = BackupDecision::Kind;

QString CountOf(int songs) {
    return SongCountText(static_cast<std::size_t>(songs));
}

// Collects the items of the batch; each file and each song counts once.
class Taking {
 public:
    Taking(TMusicDatabase& database, FileBatch& batch, BackupResult& result)
        : database_(database), batch_(batch), result_(result) {}

    void Tie(const BackupFile& file, SongHandle song) {
        const TID3Tag* record = database_.Songs().Find(song);
        if (record == nullptr) return Fail(file, u"Der Song ist nicht mehr in der Datenbank"_s);
        if (tied_.contains(song.Slot))
            return Fail(file, u"Der Song ist schon mit einer anderen Datei verknüpft"_s);
        tied_.insert(song.Slot);
        TID3Tag after = *record;
        after.FileName = file.Tag.FileName;
        if (!IsCdPath(record->FileName) && FileSource::Exists(record->FileName))
            ownFiles_.push_back({after.FileName, record->FileName});
        Add(file, FileItem().Record(*record, std::move(after)), result_.Tied);
    }

    void TakeIn(const BackupFile& file) {
        TID3Tag record = file.Tag;
        if (database_.IsBanned(record)) return Fail(file, u"Der Song ist verbannt"_s);
        record.AddTime = CurrentClock().Now();
        Add(file, FileItem().Record(std::nullopt, std::move(record)), result_.Added);
    }

    // Once the songs lie there: what is noted of songs follows them.
    void NoteOwnFiles() const {
        for (const auto& [song, own] : ownFiles_)
            if (database_.Contains(song)) NoteOwnFile(database_, song, own);
    }

 private:
    void Add(const BackupFile& file, FileItem& item, int& count) {
        if (database_.Contains(file.Tag.FileName))
            return Fail(file, u"Die Datei ist schon in der Datenbank"_s);
        batch_.Add(std::move(item.Then([this, path = file.Path, &count](const ItemResult& done) {
            if (done.IsComplete())
                ++count;
            else
                result_.Failed << path + u": "_s + done.Message;
        })));
    }
    void Fail(const BackupFile& file, const QString& reason) {
        result_.Failed << file.Path + u": "_s + reason;
    }

    TMusicDatabase& database_;
    FileBatch& batch_;
    BackupResult& result_;
    QSet<quint32> tied_;  // slots of songs
    std::vector<SideRow> ownFiles_;
};

}  // namespace

std::vector<BackupDecision> ProposeDecisions(const std::vector<BackupCandidates>& candidates) {
    std::vector<BackupDecision> decisions(candidates.size());
    std::vector<std::size_t> files(candidates.size());
    std::iota(files.begin(), files.end(), 0);
    const auto rank = [&](std::size_t file) {
        if (candidates[file].empty()) return std::tuple(0, 0.0);
        const BackupCandidate& best = candidates[file].front();
        return std::tuple(-static_cast<int>(best.Rating), -best.Percent);
    };
    std::ranges::stable_sort(files, {}, rank);
    QSet<quint32> taken;  // slots of songs
    for (const std::size_t file : files) {
        if (candidates[file].empty()) decisions[file].What = Kind::TakeIn;
        for (const BackupCandidate& candidate : candidates[file]) {
            if (candidate.Rating < BackupRating::Much || candidate.HasOwnFile) break;
            if (taken.contains(candidate.Song.Slot)) continue;
            taken.insert(candidate.Song.Slot);
            decisions[file] = {.What = Kind::Tie, .Song = candidate.Song};
            break;
        }
    }
    return decisions;
}

BackupResult TakeBackup(TMusicDatabase& database, const BackupMedium& medium, const QString& name,
                        const std::vector<BackupFile>& files, const std::vector<BackupDecision>& decisions) {
    const auto wanted = std::ranges::count_if(
        decisions, [](const BackupDecision& decision) { return decision.What != Kind::Skip; });
    if (wanted == 0) return {};
    BackupResult result;
    std::optional<ProgressRun> run(std::in_place, database, u"Lese die Songs einer Backup-CD ein"_s);
    FileBatch batch(CurrentJournal(), &database,
                    u"Backup-CD einlesen ("_s + SongCountText(static_cast<std::size_t>(wanted)) + u')');
    NameMedium(database, medium.Serial, name, medium.Label);
    Taking taking(database, batch, result);
    for (std::size_t i = 0; i < files.size(); ++i) {
        if (decisions[i].What == Kind::Tie) taking.Tie(files[i], decisions[i].Song);
        if (decisions[i].What == Kind::TakeIn) taking.TakeIn(files[i]);
    }
    batch.Settle();
    taking.NoteOwnFiles();
    run.reset();  // saving is a run of its own
    database.SaveAfterCommand();
    batch.Finish();
    return result;
}

void ReportBackup(const BackupResult& result, const QStringList& unreadable) {
    std::vector<ReportSection> sections = {{u"Nicht übernommen"_s, result.Failed, true},
                                           {u"Nicht lesbar"_s, unreadable, true}};
    std::erase_if(sections, [](const ReportSection& section) { return section.Lines.isEmpty(); });
    UserDialogs().ShowReport(
        {.Message = CountOf(result.Tied) + u" verknüpft, "_s + CountOf(result.Added) + u" neu aufgenommen."_s,
         .Sections = std::move(sections),
         .OpenAsText = {}});
}
