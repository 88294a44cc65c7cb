#include "CommonRUKTools/AbsolutePath.h"
#include "MusicManagment/database/journal/FileBatch.h"
#include "MusicManagment/database/songfiles/SongUpdates.h"
#include "cli/ChosenSongs.h"
#include "cli/CommandLine.h"
#include "cli/Commands.h"
#include "cli/JournalSession.h"
#include "cli/OpenedDatabase.h"
#include "cli/platform/Terminal.h"

using namespace Qt::StringLiterals;

namespace {

bool TrashFiles(const QStringList& paths, Console& console) {
    JournalSession journal(console);
    FileBatch batch(&journal.Get(), nullptr,
                    SongCountText(static_cast<std::size_t>(paths.size())) + u" löschen"_s);
    for (const QString& path : paths) {
        FileItem item;
        item.Trash(AbsolutePath(path));
        batch.Add(std::move(item));
    }
    batch.Finish();
    for (const QString& failure : batch.Failures())
        console.Message(Printable(failure));
    return batch.Failures().isEmpty();
}

bool TrashSongs(const QString& fileName, const QStringList& paths, Console& console) {
    TMusicDatabase database;
    PrepareDatabase(database);
    OpenForChanges(database, fileName, false, console);
    const ChosenSongs chosen = NamedSongs(database, paths, console);
    const JournalSession journal(console);
    const RunWatcher watcher(database, console, StopBy::Interrupt);
    const QString caption = SongCountText(chosen.Songs.size()) + u" löschen"_s;
    return ReportChanges(DiscardSongs(database, caption, chosen.Songs, Banning::NotBanned), console) &&
           chosen.AllFound;
}

int RunTrash(const Arguments& arguments, Console& console) {
    const InterruptGuard guard;
    const QString fileName = arguments.Value(u"--db");
    const bool done = fileName.isEmpty() ? TrashFiles(arguments.Operands(), console)
                                         : TrashSongs(fileName, arguments.Operands(), console);
    return done ? esDone : esFailed;
}

constexpr OptionRow kOptions[] = {
    {u"--db", u"DATENBANK",
     u"Sammlung (.tsdb), aus der die Songs gehen; ohne sie werden nur die Dateien bewegt"},
};

}  // namespace

const CommandRow kTrashCommand = {
    u"trash",
    u"Legt die Dateien von Songs in den Papierkorb",
    u"Der Befehl undo holt sie zurück, solange sie dort liegen.\n",
    {u"SONG", u"Musikdateien"},
    kOptions,
    RunTrash,
};
