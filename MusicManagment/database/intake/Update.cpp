#include "MusicManagment/database/intake/Update.h"

#include <QDir>
#include <QFileInfo>
#include <QHash>

#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/FileSource.h"
#include "MusicManagment/database/Progress.h"
#include "MusicManagment/database/intake/IntakeReport.h"
#include "MusicManagment/database/songfiles/Removal.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kProgressStep = 20;
constexpr qsizetype kListedSongs = 15;

// A folder without any entry counts as missing: that is what the mount point of an unplugged disk looks like.
bool IsThere(const QString& folder) {
    return QFileInfo(folder).isDir() &&
           !QDir(folder).isEmpty(QDir::AllEntries | QDir::NoDotAndDotDot | QDir::Hidden);
}

QString WithSeparator(const QString& folder) {
    return folder.endsWith(u'/') ? folder : folder + u'/';
}

struct UpdateFolderSets {
    QStringList There;
    QStringList Missing;
};

UpdateFolderSets SplitFolders(const QStringList& folders) {
    UpdateFolderSets sets;
    for (const QString& folder : folders)
        (IsThere(folder) ? sets.There : sets.Missing) << folder;
    return sets;
}

bool LiesBelow(const QString& path, const QStringList& folders) {
    return std::any_of(folders.begin(), folders.end(),
                       [&path](const QString& folder) { return path.startsWith(WithSeparator(folder)); });
}

// Decides of missing files whether they are gone or only out of reach.
class GoneFiles {
 public:
    explicit GoneFiles(const UpdateFolderSets& folders) : folders_(folders) {}

    bool IsGone(const QString& path) {
        if (IsCdPath(path) || FileSource::Exists(path)) return false;
        if (LiesBelow(path, folders_.Missing)) return false;
        if (LiesBelow(path, folders_.There)) return true;
        // Elsewhere only the file's own folder can tell.
        const QString folder = QFileInfo(path).path();
        const auto known = folderThere_.constFind(folder);
        if (known != folderThere_.constEnd()) return *known;
        return *folderThere_.insert(folder, QFileInfo(folder).isDir());
    }

 private:
    const UpdateFolderSets& folders_;
    QHash<QString, bool> folderThere_;
};

// The collection's own knowledge of a song outlives its tags.
TID3Tag WithCollectionFields(TID3Tag read, const TID3Tag& known) {
    read.FileName = known.FileName;
    read.PlayCount = known.PlayCount;
    read.Reserved = known.Reserved;
    read.Flags = known.Flags;
    if ((known.Flags & sfLengthCorrect) != 0) read.Length = known.Length;
    if (known.MainGenre != 0) read.MainGenre = known.MainGenre;
    read.AddTime = known.AddTime;
    if (read.Genre == kNoGenre || read.Genre == MainGenreGenre(known.MainGenre)) read.Genre = known.Genre;
    return read;
}

// What a database file keeps of the year is a number; a difference in spelling alone is none.
bool SameSong(const TID3Tag& a, const TID3Tag& b) {
    TID3Tag normal = a;
    if (YearNumber(a.Year) == YearNumber(b.Year)) normal.Year = b.Year;
    return normal == b;
}

bool ProgressAt(TMusicDatabase& database, qint64 current, qint64 total, const QString& description) {
    return database.Progress(
        {.Cur = current, .Max = total, .Type = ptSearchFolders, .Description = description});
}

// Paths first, because an updated song may change its place while the list is walked.
QStringList AllPaths(const TMusicDatabase& database) {
    QStringList paths;
    paths.reserve(database.Count());
    for (const auto& song : database.Songs())
        paths << song->FileName;
    return paths;
}

void RereadSong(TMusicDatabase& database, const QString& path, UpdateResult& result) {
    SongReading reading = ReadSong(path, database.AudioReadOptions());
    if (!reading.Error.isEmpty()) {
        result.Intake.UnreadableNames << path + u": "_s + reading.Error;
        ++result.Intake.Unreadable;
    }
    const TID3Tag* known = database.Songs().Find(path);
    if (!reading.Succeeded() || known == nullptr) return;
    TID3Tag read = WithCollectionFields(std::move(reading.Tag), *known);
    if (SameSong(read, *known)) return;
    if (database.UpdateEntry(database.IndexOf(path), std::move(read)) >= 0) result.Changed << path;
}

// Looks at every song: gone ones are returned, present ones are read again where asked for.
QStringList CheckSongs(TMusicDatabase& database, UpdateTags tags, const UpdateFolderSets& folders,
                       UpdateResult& result) {
    GoneFiles goneFiles(folders);
    QStringList gone;
    const QStringList paths = AllPaths(database);
    for (qsizetype i = 0; i < paths.size(); ++i) {
        if (i % kProgressStep == 0 &&
            ProgressAt(database, i, paths.size(), u"Prüfe die vorhandenen Songs"_s)) {
            result.Stopped = true;
            break;
        }
        if (goneFiles.IsGone(paths[i]))
            gone << paths[i];
        else if (tags == UpdateTags::Reread && !IsCdPath(paths[i]))
            RereadSong(database, paths[i], result);
    }
    return gone;
}

bool ConfirmRemoval(const QStringList& gone) {
    QString text =
        u"Diese Songs ("_s + QString::number(gone.size()) +
        u") sind nicht mehr auf der Festplatte vorhanden. Sollen sie aus der Datenbank entfernt werden?\n"_s;
    for (const QString& path : gone.first(std::min(gone.size(), kListedSongs)))
        text += u'\n' + path;
    if (gone.size() > kListedSongs)
        text += u"\n... und "_s + QString::number(gone.size() - kListedSongs) + u" weitere"_s;
    return UserDialogs().Ask({.Text = text, .Buttons = {u"Entfernen"_s, u"Behalten"_s}, .Cancel = 1}) == 0;
}

void RequireFolders(const TMusicDatabase& database) {
    if (database.ProgressRunning())
        throw EMusicDatabaseException(u"Hinzufügen von Songs zur Datenbank ist momentan nicht möglich."_s);
    if (database.UpdateFolders().isEmpty())
        throw EMusicDatabaseException(
            u"Es ist noch kein Ordner eingetragen, in dem nach Songs gesucht werden soll. Fügen Sie zuerst "
            u"einen Ordner zur "
            "Datenbank hinzu."_s);
}

std::vector<ReportSection> UpdateSections(const UpdateResult& result) {
    std::vector<ReportSection> sections = IntakeSections(result.Intake);
    sections.push_back({u"Geänderte Tags übernommen"_s, result.Changed});
    sections.push_back({u"Aus der Datenbank entfernt"_s, result.Removed});
    sections.push_back({u"Nicht erreichbare Ordner"_s, result.MissingFolders, true});
    return sections;
}

void AppendLines(QString& text, const QString& heading, const QStringList& lines) {
    if (lines.isEmpty()) return;
    text += heading + u" ("_s + QString::number(lines.size()) + u"):\n"_s + lines.join(u'\n') + u"\n\n"_s;
}

}  // namespace

UpdateResult UpdateDatabase(TMusicDatabase& database, UpdateTags tags) {
    RequireFolders(database);
    const UpdateFolderSets folders = SplitFolders(database.UpdateFolders());
    UpdateResult result;
    result.MissingFolders = folders.Missing;
    QStringList gone;
    {
        const ProgressRun run(database, u"Datenbank updaten"_s);
        gone = CheckSongs(database, tags, folders, result);
    }
    if (!result.Stopped) {
        const auto unreadable = result.Intake;
        result.Intake = AddPaths(database, folders.There, true);
        result.Intake.Unreadable += unreadable.Unreadable;
        result.Intake.UnreadableNames << unreadable.UnreadableNames;
        result.Stopped = result.Intake.Stopped;
    }
    if (!gone.isEmpty() && ConfirmRemoval(gone)) {
        RemoveSongs(database, gone);
        result.Removed = gone;
    }
    ShowReport(UpdateMessage(result), UpdateSections(result), UpdateDetails(result));
    database.SaveAfterCommand();
    return result;
}

QStringList MergeFolders(QStringList folders, const QStringList& more) {
    for (const QString& folder : more) {
        if (folders.contains(folder) || LiesBelow(folder, folders)) continue;
        folders.removeIf([&folder](const QString& other) { return LiesBelow(other, {folder}); });
        folders << folder;
    }
    return folders;
}

void RememberFolders(TMusicDatabase& database, const QStringList& folders) {
    const QStringList remembered = MergeFolders(database.UpdateFolders(), folders);
    if (remembered == database.UpdateFolders()) return;
    database.SetUpdateFolders(remembered);
    database.SetModified(true);
}

IntakeResult SearchNewSongs(TMusicDatabase& database) {
    RequireFolders(database);
    IntakeResult result = AddPaths(database, SplitFolders(database.UpdateFolders()).There, true);
    ReportIntake(result);
    database.SaveAfterCommand();
    return result;
}

QString UpdateMessage(const UpdateResult& result) {
    QString text = IntakeMessage(result.Intake);
    if (!result.Changed.isEmpty())
        text += u"\nBei "_s + QString::number(result.Changed.size()) +
                u" Song(s) wurden geänderte Tags übernommen."_s;
    if (!result.Removed.isEmpty())
        text += u"\n"_s + QString::number(result.Removed.size()) +
                u" Song(s) wurde(n) aus der Datenbank entfernt."_s;
    if (!result.MissingFolders.isEmpty())
        text += u"\nNicht erreichbar, ihre Songs bleiben in der Datenbank:\n"_s +
                result.MissingFolders.join(u'\n');
    if (result.Stopped) text += u"\nDer Vorgang wurde abgebrochen."_s;
    return text;
}

QString UpdateDetails(const UpdateResult& result) {
    QString text = IntakeDetails(result.Intake);
    if (!text.endsWith(u'\n')) text += u'\n';
    text += u'\n';
    AppendLines(text, u"Geänderte Tags wurden übernommen bei"_s, result.Changed);
    AppendLines(text, u"Aus der Datenbank entfernt"_s, result.Removed);
    AppendLines(text, u"Nicht erreichbare Ordner"_s, result.MissingFolders);
    return text;
}
