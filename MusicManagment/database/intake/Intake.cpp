#include "MusicManagment/database/intake/Intake.h"

#include <QFileInfo>
#include <algorithm>
#include <utility>

#include "CommonRUKTools/AbsolutePath.h"
#include "CommonRUKTools/Clock.h"
#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/Volumes.h"
#include "MusicManagment/database/ListGuards.h"
#include "MusicManagment/database/intake/FolderWalk.h"
#include "MusicManagment/database/intake/IntakeReport.h"
#include "MusicManagment/database/intake/KnownSongs.h"
#include "MusicManagment/database/intake/MediumQuestion.h"
#include "MusicManagment/database/intake/ReadAhead.h"
#include "MusicManagment/database/intake/UpdateFolders.h"
#include "MusicManagment/database/media/CataloguedMedia.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kFilesPerProgressPoint = 5;

QString FileRunText() {
    return u"Nehme Songs in die Datenbank auf"_s;
}

QString FolderRunText() {
    return u"Dursuche Ordner nach neuen Songs"_s;
}

// Reading thousands of files only to have each refused would help nobody, so a database that cannot change
// says so at once.
void RefuseUnless(bool possible) {
    if (!possible)
        throw EMusicDatabaseException(u"Hinzufügen von Songs zur Datenbank ist momentan nicht möglich."_s);
}

bool TakesSongs(const TMusicDatabase& database) {
    return !database.Busy() && !database.ReadOnly();
}

void RefuseWhenLocked(const TMusicDatabase& database) {
    RefuseUnless(TakesSongs(database) && !database.ProgressRunning());
}

// A file is known under one spelling of its path only.
QString CleanPath(const QString& path) {
    return IsCdPath(path) ? path : AbsolutePath(path);
}

void NoteUnreadable(const QString& reason, IntakeResult& result) {
    ++result.Unreadable;
    result.UnreadableNames << reason;
}

void NoteUnreadable(const QStringList& reasons, IntakeResult& result) {
    result.Unreadable += static_cast<int>(reasons.size());
    result.UnreadableNames << reasons;
}

// `path` is where the file lies.
bool TakeIn(TMusicDatabase& database, const QString& path, const QString& stored, const SongReading& reading,
            IntakeResult& result) {
    if (!reading.Succeeded()) {
        NoteUnreadable(reading.Refusal.isEmpty() ? reading.Error : reading.Refusal + u": "_s + path, result);
        return false;
    }
    if (database.AddEntry(stored, reading.Tag) >= 0) {
        ++result.Added;
        result.NewFiles << stored;
        if (reading.Tag.BitRate == 0) result.DamagedFiles << path;
        return true;
    }
    if (database.IsBanned(reading.Tag)) {
        ++result.Banned;
        result.BannedFiles << path;
    } else {
        NoteUnreadable(u"Nicht aufgenommen: "_s + path, result);
    }
    return false;
}

bool ReportCacheList(TMusicDatabase& database, std::size_t done) {
    return database.Progress({.Cur = static_cast<qint64>(done),
                              .Max = database.Count(),
                              .Type = ptSearchFolders,
                              .Description = u"Erstelle Cache-Liste"_s});
}

// The songs of a collection are found by an index over their paths. In a large one it takes its time, and the
// user may do meanwhile whatever leaves the songs where they are.
void MakePathIndex(TMusicDatabase& database) {
    const BusyGuard unchanged(database);
    database.Songs().IndexPaths([&database](std::size_t done) { return ReportCacheList(database, done); });
}

// Turns what the user gave into a list of song files.
class Collector {
 public:
    Collector(TMusicDatabase& database, bool withSubfolders, IntakeResult& result)
        : walk_({.WithSubfolders = withSubfolders,
                 .IsWanted = &IsSongFile,
                 .Progress =
                     [&database](const QString& folder) {
                         return database.Progress({.Type = ptSearchFolders, .Description = folder});
                     }}),
          result_(result) {}

    void AddFolder(const QString& folder) {
        if (!result_.Stopped) result_.Stopped = !walk_.Walk(folder, files_);
    }

    void AddFile(const QString& path, bool exists) {
        if (IsSongFile(path))
            files_ << path;
        else
            NoteUnreadable((exists ? u"Keine Musikdatei: "_s : u"Datei nicht gefunden: "_s) + path, result_);
    }

    QStringList Finish() {
        NoteUnreadable(walk_.Unreadable(), result_);
        return std::move(files_);
    }

 private:
    FolderWalk walk_;
    IntakeResult& result_;
    QStringList files_;
};

struct GivenPath {
    QString Path;
    bool Exists;
    bool IsFolder;
};

std::vector<GivenPath> LookAt(const QStringList& paths) {
    std::vector<GivenPath> given;
    for (const QString& path : paths) {
        const QString clean = CleanPath(path);
        const QFileInfo info(clean);
        given.push_back({clean, info.exists(), info.isDir()});
    }
    return given;
}

// Walks and adds within one run.
IntakeResult AddGiven(TMusicDatabase& database, const std::vector<GivenPath>& given, bool withSubfolders) {
    const bool anyFolder =
        std::any_of(given.begin(), given.end(), [](const GivenPath& path) { return path.IsFolder; });
    const ProgressRun run(database, anyFolder ? FolderRunText() : FileRunText());
    IntakeResult result;
    Collector collector(database, withSubfolders, result);
    if (anyFolder) ReportCacheList(database, 0);
    MakePathIndex(database);
    for (const GivenPath& path : given) {
        if (path.IsFolder)
            collector.AddFolder(path.Path);
        else
            collector.AddFile(path.Path, path.Exists);
    }
    QStringList files = collector.Finish();
    if (!result.Stopped) AddFileList(database, files, true, nullptr, &result);
    return result;
}

void Remember(TMusicDatabase& database, const std::vector<GivenPath>& given) {
    QStringList folders;
    for (const GivenPath& path : given)
        if (path.IsFolder) folders << path.Path;
    RememberFolders(database, folders);
}

// Saved before anybody is told, for a report may stand there for hours.
IntakeResult AddAndSave(TMusicDatabase& database, const std::vector<GivenPath>& given, bool withSubfolders,
                        GivenFolders folders) {
    IntakeResult result = AddGiven(database, given, withSubfolders);
    if (folders == GivenFolders::Remembered) Remember(database, given);
    database.SaveAfterCommand();
    return result;
}

IntakeResult AddChosenFiles(TMusicDatabase& database, QStringList files) {
    const ProgressRun run(database, FileRunText());
    IntakeResult result;
    MakePathIndex(database);
    AddFileList(database, files, true, nullptr, &result);
    return result;
}

QStringList AskForFiles() {
    FileDialogOptions options;
    options.Title = u"Songs zur Datenbank hinzufügen"_s;
    options.Filter = u"Musik|"_s + AcceptedExtensions().replace(u'.', u"*."_s) + u"|Alle Dateien|*.*"_s;
    return UserDialogs().OpenFiles(options);
}

QString AskForFolder(bool withSubfolders) {
    const QString caption = u"Ordner zum Durchsuchen nach Songs auswählen ("_s +
                            (withSubfolders ? u"inkl."_s : u"ohne"_s) + u" Unterordner):"_s;
    return UserDialogs().ChooseFolder(caption).value_or(QString());
}

}  // namespace

IntakeResult AddSongsFromDialog(TMusicDatabase& database, const QStringList& files) {
    RefuseWhenLocked(database);
    const QStringList chosen = files.isEmpty() ? AskForFiles() : files;
    if (chosen.isEmpty()) return {};
    AskAboutMedia(database, chosen);
    IntakeResult result = AddChosenFiles(database, chosen);
    database.SaveAfterCommand();
    ReportIntake(result);
    return result;
}

IntakeResult AddFolder(TMusicDatabase& database, const QString& folder, bool withSubfolders,
                       GivenFolders folders) {
    RefuseWhenLocked(database);
    const QString chosen = folder.isEmpty() ? AskForFolder(withSubfolders) : folder;
    if (chosen.isEmpty()) return {};
    AskAboutMedia(database, {chosen});
    IntakeResult result = AddAndSave(database, {{AbsolutePath(chosen), true, true}}, withSubfolders, folders);
    ReportIntake(result);
    return result;
}

IntakeResult AddPaths(TMusicDatabase& database, const QStringList& paths, bool withSubfolders,
                      GivenFolders folders) {
    RefuseWhenLocked(database);
    return AddAndSave(database, LookAt(paths), withSubfolders, folders);
}

int AddFileList(TMusicDatabase& database, QStringList& list, bool checkExisting, QStringList* newNames,
                IntakeResult* result) {
    RefuseUnless(TakesSongs(database));
    IntakeResult unasked;
    IntakeResult& outcome = result != nullptr ? *result : unasked;
    QStringList candidates = std::exchange(list, {});
    for (QString& path : candidates)
        path = CleanPath(path);
    if (checkExisting) CurrentVolumes().Forget();
    const CataloguedMedia media(database);
    KnownSongs known(database);
    const auto isKnown = [&](const QString& path) {
        return checkExisting && known.Contains(path, media.StoredPath(path));
    };
    // A progress point that nobody hears of, for the time in which nothing goes on.
    const auto goOn = [&database] { return !database.Progress(database.LastProgress(), false, false); };
    ReadOptions options = database.AudioReadOptions();
    ReadAhead files(candidates, options, isKnown);
    for (qsizetype i = 0; i < candidates.size() && !outcome.Stopped; ++i) {
        if (i % kFilesPerProgressPoint == 0) {
            outcome.Stopped = database.Progress(
                {.Cur = i, .Max = candidates.size(), .Type = ptAddSongs, .Description = candidates[i]});
            if (outcome.Stopped) break;
            // The local time costs several system calls, so it is asked for only here.
            options.FileTime = CurrentClock().Now();
        }
        const QString& path = files.Next();
        if (isKnown(path)) {
            ++outcome.Known;
        } else if (const auto reading = files.Take(goOn)) {
            const QString stored = media.StoredPath(path);
            if (!TakeIn(database, path, stored, *reading, outcome)) continue;
            known.Add(path, stored);
            list << path;
        } else {
            outcome.Stopped = true;
        }
    }
    if (newNames != nullptr) *newNames << list;
    return static_cast<int>(list.size());
}

SongIndex AddSongFile(TMusicDatabase& database, const QString& path, const SongOverrides& overrides) {
    try {
        return database.AddSong(CataloguedMedia(database).StoredPath(CleanPath(path)), overrides);
    } catch (const EStreamError&) {
        return -1;  // the caller learns from the number that the song is not there
    }
}
