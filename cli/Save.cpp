#include "cli/CommandLine.h"
#include "cli/Commands.h"
#include "cli/OpenedDatabase.h"
#include "cli/platform/Terminal.h"

using namespace Qt::StringLiterals;

namespace {

constexpr ChoiceRow<int> kCompressions[] = {
    {u"none", clNone},
    {u"fastest", clFastest},
    {u"default", clDefault},
    {u"max", clMax},
};

int RunSave(const Arguments& arguments, Console& console) {
    const QString target = arguments.Value(u"--out");
    const InterruptGuard guard;
    TMusicDatabase database;
    PrepareDatabase(database);
    database.SetCompression(ChoiceOf(arguments, u"--compression", kCompressions, database.Compression()));
    ClaimFile(database, target);
    ReadInto(database, arguments.Value(u"--db"), console, StopBy::Interrupt);
    const RunWatcher watcher(database, console, StopBy::Interrupt);
    if (database.SaveDatabase(target)) return esDone;
    console.Message(u"Abgebrochen; "_s + target + u" ist nicht geschrieben worden."_s);
    return esFailed;
}

constexpr OptionRow kOptions[] = {
    {u"--db", u"DATENBANK", u"Datei der Sammlung (.tsdb), gleich welcher Version", true},
    {u"--out", u"DATEI", u"Datei, die geschrieben oder ersetzt wird", true},
    {u"--compression", u"STUFE", u"none, fastest (Vorgabe), default oder max"},
};

}  // namespace

const CommandRow kSaveCommand = {
    u"save",
    u"Schreibt die Sammlung in eine Datei der Version 2.0",
    u"Die Datei erscheint erst unter ihrem Namen, wenn sie vollständig ist. Beim Lesen der Versionen 1.0 "
    u"bis\n"
    u"1.2 werden die Musikdateien neu gelesen.\n",
    {u"", u""},
    kOptions,
    RunSave,
};
