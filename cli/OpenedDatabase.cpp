#include "cli/OpenedDatabase.h"

#include "CommonRUKTools/AbsolutePath.h"
#include "CommonRUKTools/FileSource.h"
#include "CommonRUKTools/StandardFiles.h"
#include "MusicManagment/database/BannList.h"
#include "cli/JournalSession.h"

using namespace Qt::StringLiterals;

void PrepareDatabase(TMusicDatabase& database, Rules rules) {
    database.SetAsynchronous(false);
    UseRules(database, rules);
}

void ClaimFile(TMusicDatabase& database, const QString& fileName) {
    database.Lock().SetWanted(true);
    database.Lock().Claim(fileName);
    if (database.Lock().IsElsewhere()) throw EAbort();
}

void ReadInto(TMusicDatabase& database, const QString& fileName, Console& console, StopBy stopBy) {
    const RunWatcher watcher(database, console, stopBy);
    if (!database.OpenDatabase(fileName, true)) throw EMusicDatabaseException(u"Abgebrochen."_s);
}

void OpenForChanges(TMusicDatabase& database, const QString& fileName, bool onlyReads, Console& console) {
    if (onlyReads) return ReadInto(database, fileName, console, StopBy::Interrupt);
    ClaimFile(database, fileName);
    ReadInto(database, fileName, console, StopBy::Interrupt);
    database.SetFileName(fileName);
    database.SetAutoSave(-1);
    // Now, because the command may find nothing to change.
    if (CatchUp(database, console) > 0) database.SaveAfterCommand();
}

bool ReportChanges(const BatchResult& result, Console& console) {
    for (const QString& failure : result.Failed)
        console.Message(Printable(failure));
    if (result.Stopped) console.Message(u"Abgebrochen; was bis dahin geändert ist, bleibt."_s);
    return result.Failed.isEmpty() && !result.Stopped;
}

QString BannListFor(const QString& fileName, const Arguments& arguments) {
    if (QString list = arguments.Value(kBannListOption.Name); !list.isEmpty()) return list;
    const StandardFiles standard = LocateStandardFiles();
    const bool isStandard =
        !fileName.isEmpty() && AbsolutePath(fileName) == AbsolutePath(standard.Database());
    return isStandard ? standard.BannList() : QString();
}

void LoadBannListFor(TMusicDatabase& database, const QString& fileName, const Arguments& arguments) {
    const QString list = BannListFor(fileName, arguments);
    // One that was named must be there.
    if (arguments.Has(kBannListOption.Name) || FileSource::Exists(list))
        LoadBannList(database.BannList(), list);
}
