#include <QDateTime>

#include "CommonRUKTools/AbsolutePath.h"
#include "cli/BannListKeeper.h"
#include "cli/CommandLine.h"
#include "cli/Commands.h"
#include "cli/JournalSession.h"
#include "cli/JsonOutput.h"
#include "cli/OpenedDatabase.h"
#include "cli/platform/Terminal.h"

using namespace Qt::StringLiterals;

namespace {

void WriteBatch(const BatchInfo& batch, bool asJson, Console& console) {
    const QDateTime time = QDateTime::fromMSecsSinceEpoch(batch.Time);
    if (!asJson) {
        const QString database = batch.Database.isEmpty() ? u"-"_s : Printable(batch.Database);
        return console.WriteLine(time.toString(u"yyyy-MM-dd hh:mm:ss"_s) + u'\t' + batch.Caption + u'\t' +
                                 QString::number(batch.Files) + u'\t' + database);
    }
    JsonLine line;
    line.Begin();
    line.Text("time", time.toUTC().toString(Qt::ISODate));
    line.Text("caption", batch.Caption);
    line.Number("files", batch.Files);
    line.Text("database", batch.Database);
    console.Write(line.End());
}

int List(Journal& journal, bool asJson, Console& console) {
    for (const BatchInfo& batch : journal.Batches())
        WriteBatch(batch, asJson, console);
    return esDone;
}

void WriteResult(const UndoResult& result, bool asJson, Console& console) {
    if (!asJson) return console.WriteLine(u"Rückgängig gemacht: "_s + result.Caption);
    JsonLine line;
    line.Begin();
    line.Text("caption", result.Caption);
    line.Number("items", result.Items);
    line.Texts("problems", result.Problems);
    console.Write(line.End());
}

UndoResult UndoIn(TMusicDatabase* database, Journal& journal) {
    try {
        return journal.Undo(database);
    } catch (const EOtherDatabase& error) {
        if (error.Database().isEmpty()) throw;
        throw ERukException(error.Message() + u" (anzugeben mit --db)"_s);
    }
}

int RunUndo(const Arguments& arguments, Console& console) {
    const bool asJson = arguments.Has(u"--json");
    const InterruptGuard guard;
    JournalSession session(console);
    Journal& journal = session.Get();
    if (arguments.Has(u"--list")) return List(journal, asJson, console);
    const auto last = journal.ToUndo();
    if (!last) {
        console.Message(u"Es gibt nichts, was rückgängig gemacht werden kann."_s);
        return esFailed;
    }
    // The batch names its database; any other is refused.
    const QString fileName = arguments.Has(u"--db") ? arguments.Value(u"--db") : last->Database;
    TMusicDatabase database;
    PrepareDatabase(database);
    if (!fileName.isEmpty()) OpenForChanges(database, AbsolutePath(fileName), false, console);
    const BannListKeeper bannList(database, BannListFor(fileName, arguments), console);
    const UndoResult result = UndoIn(fileName.isEmpty() ? nullptr : &database, journal);
    if (!fileName.isEmpty()) database.SaveAfterCommand();
    WriteResult(result, asJson, console);
    for (const QString& problem : result.Problems)
        console.Message(Printable(problem));
    return result.Problems.isEmpty() && bannList.IsKept() ? esDone : esFailed;
}

constexpr OptionRow kOptions[] = {
    {u"--db", u"DATENBANK",
     u"Sammlung, um deren Songs es geht; Vorgabe ist die des letzten Vorgangs, eine andere wird abgelehnt"},
    kBannListOption,
    {u"--list", u"", u"zeigt nur, was rückgängig gemacht werden kann, das Letzte zuerst"},
    {u"--json", u"", u"ein JSON-Objekt je Vorgang und Zeile"},
};

}  // namespace

const CommandRow kUndoCommand = {
    u"undo",
    u"Nimmt die letzte Änderung von Dateien und Songs zurück",
    u"Tags, Namen, Orte, Datensätze und Einträge der Bann-Liste werden wieder, wie sie waren, auch nach "
    u"einem\n"
    u"Neustart. Eine Datei, die sich seither geändert hat, bleibt, wie sie ist, und wird genannt; der\n"
    u"Rückgabewert ist dann 1.\n"
    u"JSON-Format: {\"caption\":TEXT,\"items\":N,\"problems\":[...]}, mit --list\n"
    u"{\"time\":TEXT,\"caption\":TEXT,\"files\":N,\"database\":TEXT}\n",
    {u"", u""},
    kOptions,
    RunUndo,
};
