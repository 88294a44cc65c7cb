#include "MusicManagment/database/intake/Update.h"

#include <algorithm>

#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/FileSource.h"
#include "MusicManagment/database/Progress.h"
#include "MusicManagment/database/intake/IntakeReport.h"
#include "MusicManagment/database/intake/MissingFiles.h"
#include "MusicManagment/database/intake/UpdateFolders.h"
#include "MusicManagment/database/songfiles/Removal.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kProgressStep = 20;
constexpr qsizetype kListedLines = 15;

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
    // Of a song whose medium is not there nothing new can be known.
    const QString file = database.ResolveSongPath(path, {.Ask = false, .UseCache = false});
    if (file.isEmpty() || (IsCdPath(path) && !FileSource::Exists(file))) return;
    SongReading reading = ReadSong(file, database.AudioReadOptions());
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

// Looks at every song; present ones are read again where asked for.
void CheckSongs(TMusicDatabase& database, UpdateTags tags, MissingFiles& missing, UpdateResult& result) {
    const QStringList paths = AllPaths(database);
    for (qsizetype i = 0; i < paths.size(); ++i) {
        if (i % kProgressStep == 0 &&
            ProgressAt(database, i, paths.size(), u"Prüfe die vorhandenen Songs"_s)) {
            result.Stopped = true;
            return;
        }
        if (missing.IsThere(paths[i]) && tags == UpdateTags::Reread) RereadSong(database, paths[i], result);
    }
}

// The first lines of a list that may be long.
QString FirstOf(const QStringList& lines) {
    QString text;
    for (const QString& line : lines.first(std::min(lines.size(), kListedLines)))
        text += u'\n' + line;
    if (lines.size() > kListedLines)
        text += u"\n... und "_s + QString::number(lines.size() - kListedLines) + u" weitere"_s;
    return text;
}

bool MayRemove(const QString& question) {
    return UserDialogs().Ask({.Text = question, .Buttons = {u"Entfernen"_s, u"Behalten"_s}, .Cancel = 1}) ==
           0;
}

bool MayRemoveSongs(const QStringList& gone) {
    return !gone.isEmpty() &&
           MayRemove(u"Diese Songs ("_s + QString::number(gone.size()) +
                     u") sind nicht mehr auf der Festplatte vorhanden. Sollen sie aus der Datenbank entfernt "
                     u"werden?\n"_s +
                     FirstOf(gone));
}

// A folder without any of its songs may as well be one on a disk that is not plugged in.
bool MayRemoveFolders(const std::vector<EmptiedFolder>& emptied) {
    if (emptied.empty()) return false;
    QStringList lines;
    qsizetype songs = 0;
    for (const auto& folder : emptied) {
        lines << folder.Folder + u" ("_s + QString::number(folder.Songs.size()) + u')';
        songs += folder.Songs.size();
    }
    return MayRemove(
        u"Von den Songs in diesen Ordnern ist kein einziger mehr da:\n"_s + FirstOf(lines) +
        u"\n\nLiegen sie auf einer Festplatte oder einem Netzlaufwerk, das gerade nicht angeschlossen ist, "
        u"dann behalten Sie sie. Sollen diese "_s +
        QString::number(songs) + u" Song(s) wirklich aus der Datenbank entfernt werden?"_s);
}

QStringList ConfirmedRemovals(const MissingFiles& missing) {
    QStringList gone = missing.Single();
    if (!MayRemoveSongs(gone)) gone.clear();
    const auto emptied = missing.ByFolder();
    if (MayRemoveFolders(emptied))
        for (const auto& folder : emptied)
            gone << folder.Songs;
    gone.removeIf(FileSource::Exists);  // a disk may have been plugged in to answer
    return gone;
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
    MissingFiles missing(FoldersToSearch(database));
    UpdateResult result;
    {
        const ProgressRun run(database, u"Datenbank updaten"_s);
        CheckSongs(database, tags, missing, result);
    }
    result.MissingFolders = missing.OutOfReach();
    if (!result.Stopped) {
        const auto unreadable = result.Intake;
        result.Intake = AddPaths(database, missing.FoldersThere(), true);
        result.Intake.Unreadable += unreadable.Unreadable;
        result.Intake.UnreadableNames << unreadable.UnreadableNames;
        result.Removed = ConfirmedRemovals(missing);
        RemoveSongs(database, result.Removed);
        result.Stopped = result.Intake.Stopped;
    }
    database.SaveAfterCommand();
    ShowReport(UpdateMessage(result), UpdateSections(result), UpdateDetails(result));
    return result;
}

IntakeResult SearchNewSongs(TMusicDatabase& database) {
    RequireFolders(database);
    IntakeResult result = AddPaths(database, MissingFiles(FoldersToSearch(database)).FoldersThere(), true);
    ReportIntake(result);
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
