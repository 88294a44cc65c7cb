#include <QFileInfo>
#include <algorithm>

#include "CommonRUKTools/AbsolutePath.h"
#include "CommonRUKTools/FileSource.h"
#include "MusicManagment/database/intake/Intake.h"
#include "MusicManagment/database/media/CataloguedMedia.h"
#include "cli/CommandLine.h"
#include "cli/Commands.h"
#include "cli/JournalSession.h"
#include "cli/JsonOutput.h"
#include "cli/OpenedDatabase.h"
#include "cli/platform/Terminal.h"

using namespace Qt::StringLiterals;

namespace {

// Asked before hours of reading, not after.
void RequireWritableFolder(const QString& fileName) {
    const QFileInfo folder(QFileInfo(fileName).absolutePath());
    if (!folder.isDir() || !folder.isWritable())
        throw EStreamError(u"In diesen Ordner kann keine Datenbank geschrieben werden: "_s +
                           folder.filePath());
}

IntakeResult TakeIn(TMusicDatabase& database, const QStringList& paths, bool withSubfolders,
                    Console& console) {
    const RunWatcher watcher(database, console, StopBy::Interrupt);
    return AddPaths(database, paths, withSubfolders);
}

void Catalogue(TMusicDatabase& database, const QStringList& paths, const QString& name) {
    for (const QString& path : paths)
        if (FileSource::Exists(path)) CatalogueMedium(database, AbsolutePath(path), name);
}

// Not to be stopped: what was taken in is to be kept.
void Save(TMusicDatabase& database, const QString& fileName, Console& console) {
    const RunWatcher watcher(database, console, StopBy::Nothing);
    database.SaveDatabase(fileName);
}

void WriteResult(const IntakeResult& result, bool asJson, Console& console) {
    if (!asJson) return console.WriteLine(IntakeMessage(result));
    JsonLine line;
    line.Begin();
    line.Number("added", result.Added);
    line.Number("known", result.Known);
    line.Number("banned", result.Banned);
    line.Number("unreadable", result.Unreadable);
    line.Texts("files", result.NewFiles);
    console.Write(line.End());
}

int RunScan(const Arguments& arguments, Console& console) {
    const QString fileName = arguments.Value(u"--db");
    const QStringList& paths = arguments.Operands();
    const auto there = std::ranges::count_if(paths, FileSource::Exists);
    const bool allThere = there == paths.size();
    RequireWritableFolder(fileName);
    const InterruptGuard guard;
    TMusicDatabase database;
    PrepareDatabase(database, arguments.Has(u"--classic") ? Rules::Classic : Rules::Modern);
    LoadBannListFor(database, fileName, arguments);
    ClaimFile(database, fileName);
    const bool isNew = !FileSource::Exists(fileName);
    if (!isNew) {
        ReadInto(database, fileName, console, StopBy::Interrupt);
        database.SetFileName(fileName);
        CatchUp(database, console);
    }

    if (arguments.Has(u"--medium")) Catalogue(database, paths, arguments.Value(u"--medium"));
    const IntakeResult result = TakeIn(database, paths, !arguments.Has(u"--no-subfolders"), console);
    // A path that was mistyped is no reason to make a database.
    if (isNew ? there > 0 : database.Modified()) Save(database, fileName, console);
    for (const QString& name : result.UnreadableNames)
        console.Message(Printable(name));
    for (const QString& file : result.BannedFiles)
        console.Message(u"In der Bann-Liste: "_s + Printable(file));
    WriteResult(result, arguments.Has(u"--json"), console);
    if (isNew && there == 0)
        console.Message(u"Es gibt keinen der Pfade; die Datenbank ist nicht angelegt worden."_s);
    if (result.Stopped)
        console.Message(u"Abgebrochen; die bis dahin aufgenommenen Songs sind gespeichert."_s);
    return result.Stopped || !allThere ? esFailed : esDone;
}

constexpr OptionRow kOptions[] = {
    {u"--db", u"DATENBANK", u"Datei der Sammlung (.tsdb); wird angelegt, wenn sie fehlt", true},
    {u"--no-subfolders", u"", u"durchsucht Ordner ohne ihre Unterordner"},
    {u"--medium", u"[NAME]",
     u"katalogisiert den Datenträger der PFADe: seine Songs werden mit dessen Seriennummer gespeichert und\n"
     u"überall gefunden, wo er eingelegt ist; ohne NAME heißt er nach seiner Bezeichnung"},
    kBannListOption,
    {u"--classic", u"", u"liest die Tags nach den ursprünglichen Regeln des Programms"},
    {u"--json", u"", u"gibt das Ergebnis als ein JSON-Objekt aus"},
};

}  // namespace

const CommandRow kScanCommand = {
    u"scan",
    u"Nimmt Musikdateien und die Musikdateien von Ordnern in die Sammlung auf",
    u"Dateien, die schon in der Sammlung sind, werden übergangen; was nicht gelesen werden kann, steht auf\n"
    u"der Fehlerausgabe. Strg-C beendet das Aufnehmen; was bis dahin aufgenommen ist, wird gespeichert, und\n"
    u"der Rückgabewert ist 1. Er ist auch 1, wenn ein angegebener PFAD nicht vorhanden ist.\n"
    u"JSON-Format: {\"added\":N,\"known\":N,\"banned\":N,\"unreadable\":N,\"files\":[...]}\n",
    {u"PFAD", u"Musikdateien und Ordner"},
    kOptions,
    RunScan,
};
