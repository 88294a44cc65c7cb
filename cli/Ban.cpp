#include "MusicManagment/database/songfiles/SongUpdates.h"
#include "cli/BannListKeeper.h"
#include "cli/ChosenSongs.h"
#include "cli/CommandLine.h"
#include "cli/Commands.h"
#include "cli/JournalSession.h"
#include "cli/OpenedDatabase.h"
#include "cli/platform/Terminal.h"

using namespace Qt::StringLiterals;

namespace {

void WriteList(const TMusicDatabase& database, Console& console) {
    const SortedTextList& list = database.BannList();
    for (int i = 0; i < list.Count(); ++i)
        console.WriteLine(Printable(list.At(i).Text));
}

BatchResult BanSongs(TMusicDatabase& database, const ChosenSongs& chosen, Console& console) {
    const JournalSession journal(console);
    const RunWatcher watcher(database, console, StopBy::Interrupt);
    return DiscardSongs(database, SongCountText(chosen.Songs.size()) + u" verbannen"_s, chosen.Songs,
                        Banning::Banned);
}

int RunBan(const Arguments& arguments, Console& console) {
    const bool lists = arguments.Has(u"--list");
    if (lists == !arguments.Operands().isEmpty())
        throw EUsageError(u"Anzugeben ist --list oder die Songs."_s);
    const QString fileName = arguments.Value(u"--db");
    const QString listFile = BannListFor(fileName, arguments);
    if (listFile.isEmpty())
        throw EUsageError(u"Zu dieser Datenbank gehört keine Bann-Liste; --bannlist nennt eine."_s);
    const InterruptGuard guard;
    TMusicDatabase database;
    PrepareDatabase(database);
    const BannListKeeper list(database, listFile, console);
    if (lists) {
        WriteList(database, console);
        return esDone;
    }
    OpenForChanges(database, fileName, false, console);
    const ChosenSongs chosen = NamedSongs(database, arguments.Operands(), console);
    const BatchResult result = BanSongs(database, chosen, console);
    return ReportChanges(result, console) && chosen.AllFound && list.IsKept() ? esDone : esFailed;
}

constexpr OptionRow kOptions[] = {
    {u"--db", u"DATENBANK", u"Sammlung (.tsdb), in der die Songs stehen", true},
    {u"--bannlist", u"DATEI",
     u"Bann-Liste (.str), in die sie kommen; ohne die Option gilt für die Standard-Datenbank die\n"
     u"Standard-Bann-Liste"},
    {u"--list", u"", u"zeigt die Einträge der Bann-Liste"},
};

}  // namespace

const CommandRow kBanCommand = {
    u"ban",
    u"Verbannt Songs aus der Sammlung",
    u"Die Songs kommen in die Bann-Liste, verlassen die Sammlung, und ihre Dateien gehen in den Papierkorb. "
    u"Der\n"
    u"Befehl undo nimmt das zurück, solange sie dort liegen.\n",
    {.Name = u"SONG", .Help = u"Songs der Sammlung", .Required = false},
    kOptions,
    RunBan,
};
