#include "MusicManagment/database/songfiles/RenamePlan.h"
#include "cli/ChosenSongs.h"
#include "cli/CommandLine.h"
#include "cli/Commands.h"
#include "cli/JournalSession.h"
#include "cli/JsonOutput.h"
#include "cli/OpenedDatabase.h"
#include "cli/platform/Terminal.h"

using namespace Qt::StringLiterals;

namespace {

void WritePlan(const PlannedRename& plan, const QString& problem, bool asJson, Console& console) {
    if (!asJson) {
        const QString text = Printable(plan.From) + u" → "_s + Printable(plan.Move.Target);
        return console.WriteLine(problem.isEmpty() ? text : text + u": "_s + Printable(problem));
    }
    JsonLine line;
    line.Begin();
    line.Text("from", plan.From);
    line.Text("to", plan.Move.Target);
    problem.isEmpty() ? line.Null("problem") : line.Text("problem", problem);
    console.Write(line.End());
}

// A song that is in the way of another is not asked about here: both stay.
BatchResult CarryOut(TMusicDatabase& database, const std::vector<PlannedRename>& plans, Console& console) {
    const JournalSession journal(console);
    const RunWatcher watcher(database, console, StopBy::Interrupt);
    const std::vector<SongMove> moves = PossibleMoves(plans);
    return MoveSongs(database, SongCountText(moves.size()) + u" umbenennen"_s, moves);
}

int RunRename(const Arguments& arguments, Console& console) {
    const bool asJson = arguments.Has(u"--json");
    const bool dryRun = arguments.Has(u"--dry-run");
    const InterruptGuard guard;
    TMusicDatabase database;
    PrepareDatabase(database, arguments.Has(u"--classic") ? Rules::Classic : Rules::Modern);
    OpenForChanges(database, arguments.Value(u"--db"), dryRun, console);
    const ChosenSongs chosen = ChooseSongs(database, arguments, console);
    const QString pattern =
        arguments.Has(u"--pattern") ? arguments.Value(u"--pattern") : database.MP3NamePattern();
    const std::vector<PlannedRename> plans = PlanRenames(database, chosen.Songs, pattern);
    bool clear = chosen.AllFound;
    BatchResult result;
    if (!dryRun) result = CarryOut(database, plans, console);
    for (const PlannedRename& plan : plans) {
        const TID3Tag* song = database.Songs().Find(plan.Move.Song);
        const bool stayed =
            !dryRun && plan.Problem.isEmpty() && song != nullptr && song->FileName == plan.From;
        const QString problem = stayed ? u"Die Datei konnte nicht umbenannt werden"_s : plan.Problem;
        clear = clear && problem.isEmpty();
        WritePlan(plan, problem, asJson, console);
    }
    return ReportChanges(result, console) && clear ? esDone : esFailed;
}

constexpr OptionRow kOptions[] = {
    {u"--db", u"DATENBANK", u"Sammlung (.tsdb), in der die Songs stehen", true},
    {u"--pattern", u"MUSTER", u"Text und Platzhalter; Vorgabe ist %ARTIST% - %TITLE%"},
    kAllOption,
    kFilterOption,
    kClassicChangesOption,
    kDryRunOption,
    {u"--json", u"", u"ein JSON-Objekt je Song und Zeile"},
};

}  // namespace

const CommandRow kRenameCommand = {
    u"rename",
    u"Benennt die Dateien von Songs nach einem Muster um",
    u"Die Dateien bleiben in ihrem Ordner und behalten ihre Endung. Eine Datei, die schon da ist, wird nie\n"
    u"ersetzt: der Song behält dann seinen Namen, und der Rückgabewert ist 1. Der Befehl undo nimmt alles "
    u"zurück.\n"
    u"JSON-Format: {\"from\":TEXT,\"to\":TEXT,\"problem\":TEXT oder null}\n",
    {.Name = u"SONG", .Help = u"Songs der Sammlung", .Required = false},
    kOptions,
    RunRename,
};
