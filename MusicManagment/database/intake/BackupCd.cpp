#include "MusicManagment/database/intake/BackupCd.h"

#include <QFileInfo>
#include <algorithm>
#include <cstdlib>

#include "CommonRUKTools/CompStr.h"
#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/Progress.h"
#include "MusicManagment/database/intake/FolderWalk.h"
#include "MusicManagment/database/journal/FileBatch.h"
#include "MusicManagment/database/media/CataloguedMedia.h"
#include "ReadMPEGHeader/SongFileKinds.h"
#include "ReadMPEGHeader/SongReading.h"

using namespace Qt::StringLiterals;

namespace {

constexpr std::size_t kMostCandidates = 20;

QString RunText() {
    return u"Lese die Songs einer Backup-CD ein"_s;
}

QString NameOf(const TID3Tag& song) {
    return song.Artist + u" - "_s + song.Title;
}

// A song that a file of the CD may be.
struct BackupCandidate {
    SongHandle Song{};
    int Percent = 0;  // how alike the names are, 60 to 100
    // 3: also as long and as large (where there is no file to compare with: of the very same name), 2: also
    // as long, 1: only of a similar name.
    int Stars = 1;
};

struct NamedSong {
    SongHandle Song;
    std::u32string Name;
};

// Of the songs that have files of their own.
std::vector<NamedSong> NamesOf(const TMusicDatabase& database) {
    std::vector<NamedSong> names;
    for (const auto& song : database.Songs())
        if (!IsCdPath(song->FileName))
            names.push_back({database.Songs().HandleOf(*song), CompareKey(NameOf(*song))});
    return names;
}

// "085%: Artist - Title (**)"
QString CaptionOf(const TMusicDatabase& database, const BackupCandidate& candidate) {
    const TID3Tag* song = database.Songs().Find(candidate.Song);
    return QString::asprintf("%.3d%%: ", candidate.Percent) + (song != nullptr ? NameOf(*song) : QString()) +
           u" ("_s + QString(candidate.Stars, u'*') + u')';
}

// Nothing when the names are not alike.
std::optional<int> PercentAlike(std::u32string_view a, std::u32string_view b) {
    const std::size_t longer = std::max(a.size(), b.size());
    // The distance is at least the difference of the lengths.
    if (!IsAlike(longer - std::min(a.size(), b.size()), longer)) return std::nullopt;
    const std::size_t distance = EditDistance(a, b);
    if (!IsAlike(distance, longer)) return std::nullopt;
    return longer == 0 ? 100 : static_cast<int>(100 * (longer - distance) / longer);
}

int StarsOf(const TID3Tag& song, int percent, const QString& file, const TID3Tag& read) {
    if (std::abs(int{song.Length} - int{read.Length}) > 1) return 1;
    const QFileInfo own(song.FileName);
    const bool isSame = own.exists() ? own.size() == QFileInfo(file).size() : percent == 100;
    return isSame ? 3 : 2;
}

// Those whose names are similar to the one that was read from `file`, best first.
std::vector<BackupCandidate> CandidatesAmong(const TMusicDatabase& database,
                                             const std::vector<NamedSong>& names, const QString& file,
                                             const TID3Tag& read) {
    const std::u32string name = CompareKey(NameOf(read));
    std::vector<BackupCandidate> candidates;
    for (const NamedSong& song : names) {
        const auto percent = PercentAlike(name, song.Name);
        const TID3Tag* record = percent ? database.Songs().Find(song.Song) : nullptr;
        if (record != nullptr)
            candidates.push_back({song.Song, *percent, StarsOf(*record, *percent, file, read)});
    }
    std::ranges::stable_sort(candidates, std::greater(), [](const BackupCandidate& candidate) {
        return std::pair(candidate.Stars, candidate.Percent);
    });
    if (candidates.size() > kMostCandidates) candidates.resize(kMostCandidates);
    return candidates;
}

// A file of the CD, and what becomes of it.
struct BackupFile {
    QString Path;
    QString Stored;
    TID3Tag Tag;
    std::vector<BackupCandidate> Candidates;
    SongHandle TiedTo{};
    bool IsNew = false;
};

std::vector<BackupFile> ReadFiles(TMusicDatabase& database, const QString& folder, BackupResult& result) {
    const ProgressRun run(database, RunText());
    const auto stops = [&](qint64 done, qint64 total, const QString& name) {
        return database.Progress({.Cur = done, .Max = total, .Type = ptReadBackupCd, .Description = name});
    };
    QStringList paths;
    FolderWalk walk(
        {.IsWanted = &IsSongFile, .Progress = [&](const QString& name) { return stops(-1, -1, name); }});
    result.Stopped = !walk.Walk(folder, paths);
    result.Failed << walk.Unreadable();

    const CataloguedMedia media(database);
    const std::vector<NamedSong> names = NamesOf(database);
    std::vector<BackupFile> files;
    for (qsizetype i = 0; i < paths.size() && !result.Stopped; ++i) {
        result.Stopped = stops(i, paths.size(), paths[i]);
        const QString stored = media.StoredPath(paths[i]);
        if (result.Stopped || database.Contains(stored)) continue;
        SongReading reading = ReadSong(paths[i], database.AudioReadOptions());
        if (!reading.Succeeded()) {
            result.Failed << paths[i] + u": "_s + reading.Failure();
            continue;
        }
        auto candidates = CandidatesAmong(database, names, paths[i], reading.Tag);
        files.push_back({paths[i], stored, std::move(reading.Tag), std::move(candidates)});
    }
    return files;
}

// A song is one file of the CD only.
void ForgetTied(const std::vector<BackupFile>& files, BackupFile& file) {
    std::erase_if(file.Candidates, [&](const BackupCandidate& candidate) {
        return std::ranges::find(files, candidate.Song, &BackupFile::TiedTo) != files.end();
    });
}

// False when the user wants no more.
bool Decide(const TMusicDatabase& database, BackupFile& file) {
    const QString asNew = u"Als neuen Song aufnehmen"_s;
    const QString skipped = u"Überspringen"_s;
    QStringList choices;
    for (const BackupCandidate& candidate : file.Candidates)
        choices << CaptionOf(database, candidate);
    const auto chosen =
        UserDialogs().Input(QFileInfo(file.Path).fileName(), u"Welcher Song der Sammlung ist das?"_s,
                            choices + QStringList{asNew, skipped}, choices.front());
    if (!chosen) return false;
    const qsizetype place = choices.indexOf(*chosen);
    file.IsNew = *chosen == asNew;
    if (place >= 0) file.TiedTo = file.Candidates[static_cast<std::size_t>(place)].Song;
    return true;
}

// Files that are like no song are asked about together.
void DecideStrangers(std::vector<BackupFile>& files) {
    std::size_t count = 0;
    for (const BackupFile& file : files)
        count += file.Candidates.empty() ? 1 : 0;
    if (count == 0) return;
    const int answer = UserDialogs().Ask({.Text = u"Keinem Song der Sammlung ähnlich: "_s +
                                                  SongCountText(count) + u" auf der CD. Als neu aufnehmen?"_s,
                                          .Buttons = {u"Aufnehmen"_s, u"Überspringen"_s},
                                          .Cancel = 1});
    for (BackupFile& file : files)
        if (file.Candidates.empty()) file.IsNew = answer == 0;
}

void DecideAll(const TMusicDatabase& database, std::vector<BackupFile>& files, BackupResult& result) {
    DecideStrangers(files);
    for (BackupFile& file : files) {
        if (file.Candidates.empty()) continue;
        ForgetTied(files, file);
        if (file.Candidates.empty()) {
            file.IsNew = false;  // every song that it could be is another file
            continue;
        }
        if (Decide(database, file)) continue;
        result.Stopped = true;
        return;
    }
}

void Apply(TMusicDatabase& database, const std::vector<BackupFile>& files, BackupResult& result) {
    FileBatch batch(CurrentJournal(), &database, u"Backup-CD einlesen"_s);
    for (const BackupFile& file : files) {
        const TID3Tag* song = database.Songs().Find(file.TiedTo);
        if (song != nullptr) {
            TID3Tag tied = *song;
            tied.FileName = file.Stored;
            batch.Add(std::move(FileItem().Record(*song, std::move(tied))));
            ++result.Tied;
        } else if (file.IsNew && database.AddEntry(file.Stored, file.Tag) >= 0) {
            ++result.Added;
        }
    }
    batch.Settle();
    result.Failed << batch.Failures();
    result.Tied -= static_cast<int>(batch.Failures().size());
    database.SaveAfterCommand();
    batch.Finish();
}

// The folder of the CD, catalogued; empty when the user does not want it.
QString ChooseCd(TMusicDatabase& database) {
    const auto folder =
        UserDialogs().ChooseVolume(u"Backup-CD einlesen"_s, u"Bitte legen Sie die Backup-CD ein:"_s, {});
    if (!folder || folder->isEmpty()) return {};
    const Volume* found = CurrentVolumes().Holding(*folder);
    if (found == nullptr || CataloguedMedia(database).IsCatalogued(*found)) return *folder;
    const auto name = UserDialogs().Input(u"Backup-CD einlesen"_s, u"Name des Mediums:"_s, {}, found->Label);
    if (!name) return {};
    CatalogueMedium(database, *folder, *name);
    return *folder;
}

}  // namespace

BackupResult ReadBackupCd(TMusicDatabase& database) {
    RefuseDuringRun(database);
    BackupResult result;
    const QString folder = ChooseCd(database);
    if (folder.isEmpty()) return result;
    std::vector<BackupFile> files = ReadFiles(database, folder, result);
    if (!result.Stopped) DecideAll(database, files, result);
    Apply(database, files, result);
    return result;
}

void ReportBackupCd(const BackupResult& result) {
    std::vector<ReportSection> sections;
    if (!result.Failed.isEmpty()) sections.push_back({u"Nicht gelungen"_s, result.Failed, true});
    UserDialogs().ShowReport(
        {.Message = SongCountText(static_cast<std::size_t>(result.Tied)) + u" zugeordnet, "_s +
                    SongCountText(static_cast<std::size_t>(result.Added)) + u" neu aufgenommen"_s +
                    (result.Stopped ? u". Abgebrochen."_s : u"."_s),
         .Sections = std::move(sections),
         .OpenAsText = {}});
}
