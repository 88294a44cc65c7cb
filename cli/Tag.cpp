#include <QFile>
#include <QMimeDatabase>

#include "CommonRUKTools/AbsolutePath.h"
#include "MusicManagment/database/songfiles/RenameTarget.h"
#include "MusicManagment/database/songfiles/SongUpdates.h"
#include "cli/ChosenSongs.h"
#include "cli/CommandLine.h"
#include "cli/Commands.h"
#include "cli/JournalSession.h"
#include "cli/JsonOutput.h"
#include "cli/OpenedDatabase.h"
#include "cli/TagAssignment.h"
#include "cli/platform/Terminal.h"

using namespace Qt::StringLiterals;

namespace {

CoverPicture ReadPicture(const QString& path) {
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly))
        throw EStreamError(u"Kann das Bild nicht lesen: "_s + path + u": "_s + file.errorString());
    CoverPicture picture{.Bytes = file.readAll(), .MimeType = {}};
    picture.MimeType = QMimeDatabase().mimeTypeForData(picture.Bytes).name();
    if (picture.MimeType != u"image/png"_s && picture.MimeType != u"image/jpeg"_s)
        throw EStreamError(u"Das ist kein Bild im Format PNG oder JPEG: "_s + path);
    return picture;
}

std::optional<CoverChange> CoverOf(const Arguments& arguments) {
    const QString cover = arguments.Value(u"--cover");
    if (cover.isEmpty()) return std::nullopt;
    if (cover == u"none"_s) return CoverRemoval{};
    return ReadPicture(cover);
}

// Without a database the songs are those of one that is never saved.
ChosenSongs ReadSongs(TMusicDatabase& database, const QStringList& paths, Console& console) {
    ChosenSongs chosen;
    for (const QString& path : paths) {
        const SongReading reading = ReadSong(AbsolutePath(path), database.AudioReadOptions());
        if (!reading.Succeeded()) {
            chosen.AllFound = false;
            console.Message(Printable(path) + u": "_s + reading.Failure());
            continue;
        }
        if (database.Contains(reading.Tag.FileName)) continue;
        const SongIndex index = database.AddEntry(reading.Tag.FileName, reading.Tag, AddAs::Returning);
        chosen.Songs.push_back(database.Songs().HandleOf(index));
    }
    return chosen;
}

std::vector<SongUpdate> Plan(const TMusicDatabase& database, const ChosenSongs& chosen,
                             const Arguments& arguments) {
    const TagAssignments assignments(arguments.Values(u"--set"));
    const auto cover = CoverOf(arguments);
    std::vector<SongUpdate> updates;
    for (const SongHandle song : chosen.Songs) {
        const TID3Tag& before = *database.Songs().Find(song);
        SongUpdate update{.Song = song,
                          .Basis = before,
                          .Record = before,
                          .TrackTotal = assignments.TrackTotal(),
                          .Cover = cover};
        assignments.Apply(update.Record);
        updates.push_back(std::move(update));
    }
    return updates;
}

void WriteDifferences(const TID3Tag& before, const TID3Tag& after, bool asJson, Console& console) {
    JsonLine line;
    for (const FieldDifference& difference : DifferencesOf(before, after)) {
        if (asJson) {
            line.Begin();
            line.Text("fileName", before.FileName);
            line.Text("field", QString::fromLatin1(difference.Name));
            line.Text("old", difference.Old);
            line.Text("new", difference.New);
            console.Write(line.End());
        } else {
            console.WriteLine(Printable(before.FileName) + u": "_s + QString::fromLatin1(difference.Name) +
                              u": "_s + Printable(difference.Old) + u" → "_s + Printable(difference.New));
        }
    }
}

// What would happen, without the file.
TID3Tag Expected(const TMusicDatabase& database, const SongUpdate& update, bool renames) {
    TID3Tag record = update.Record;
    if (renames) record.FileName = RenameTarget(database, update.Basis.FileName, record);
    return record;
}

BatchResult CarryOut(TMusicDatabase& database, const std::vector<SongUpdate>& updates, bool renames,
                     Console& console) {
    const JournalSession journal(console);
    const RunWatcher watcher(database, console, StopBy::Interrupt);
    const QString caption = updates.size() == 1 ? u"1 Tag"_s : QString::number(updates.size()) + u" Tags"_s;
    return UpdateSongs(database, caption, updates, renames ? Renaming::BySettings : Renaming::Never,
                       u"Tags schreiben"_s);
}

int RunTag(const Arguments& arguments, Console& console) {
    const bool asJson = arguments.Has(u"--json");
    const bool renames = arguments.Has(u"--rename");
    const QString fileName = arguments.Value(u"--db");
    const bool dryRun = arguments.Has(u"--dry-run");
    if (arguments.Values(u"--set").isEmpty() && !arguments.Has(u"--cover") && !renames)
        throw EUsageError(u"Es fehlt, was zu ändern ist: --set, --cover oder --rename."_s);
    const InterruptGuard guard;
    TMusicDatabase database;
    PrepareDatabase(database, arguments.Has(u"--classic") ? Rules::Classic : Rules::Modern);
    if (!fileName.isEmpty()) OpenForChanges(database, fileName, dryRun, console);
    const ChosenSongs chosen = fileName.isEmpty() ? ReadSongs(database, arguments.Operands(), console)
                                                  : NamedSongs(database, arguments.Operands(), console);
    const std::vector<SongUpdate> updates = Plan(database, chosen, arguments);
    if (dryRun) {
        for (const SongUpdate& update : updates)
            WriteDifferences(update.Basis, Expected(database, update, renames), asJson, console);
        return chosen.AllFound ? esDone : esFailed;
    }
    const BatchResult result = CarryOut(database, updates, renames, console);
    for (const SongUpdate& update : updates)
        if (const TID3Tag* song = database.Songs().Find(update.Song))
            WriteDifferences(update.Basis, *song, asJson, console);
    return ReportChanges(result, console) && chosen.AllFound ? esDone : esFailed;
}

constexpr OptionRow kOptions[] = {
    {u"--db", u"DATENBANK",
     u"Sammlung (.tsdb), in der die Songs stehen; ohne sie werden nur die Dateien geändert"},
    {u"--set", u"FELD=WERT",
     u"title, artist, album, year, comment, track, trackTotal, genre, mainGenre, remix, flags oder "
     u"playCount;\n"
     u"darf mehrmals stehen"},
    {u"--cover", u"BILD", u"PNG- oder JPEG-Datei als Cover; none entfernt es"},
    {u"--rename", u"", u"benennt die Dateien auch um, in ihrem Ordner"},
    kClassicChangesOption,
    kDryRunOption,
    {u"--json", u"", u"ein JSON-Objekt je geändertem Feld und Zeile"},
};

}  // namespace

const CommandRow kTagCommand = {
    u"tag",
    u"Ändert die Tags von Songs",
    u"Alles andere in den Tags (Bilder, Liedtexte, fremde Frames) bleibt, wie es ist. Eine Datei, die nicht\n"
    u"geschrieben werden kann, hält die anderen nicht auf; der Rückgabewert ist dann 1. Der Befehl undo "
    u"nimmt\n"
    u"alles zurück.\n"
    u"JSON-Format: {\"fileName\":TEXT,\"field\":TEXT,\"old\":TEXT,\"new\":TEXT}\n",
    {u"SONG", u"Musikdateien"},
    kOptions,
    RunTag,
};
