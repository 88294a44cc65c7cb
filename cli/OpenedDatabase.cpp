#include "cli/OpenedDatabase.h"

#include "CommonRUKTools/AbsolutePath.h"
#include "CommonRUKTools/FileSource.h"
#include "CommonRUKTools/StandardFiles.h"
#include "MusicManagment/database/BannList.h"

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

void LoadBannListFor(TMusicDatabase& database, const QString& fileName, const Arguments& arguments) {
    QString list = arguments.Value(kBannListOption.Name);
    const StandardFiles standard = LocateStandardFiles();
    const bool isStandard = AbsolutePath(fileName) == AbsolutePath(standard.Database());
    if (list.isEmpty() && isStandard && FileSource::Exists(standard.BannList())) list = standard.BannList();
    if (!list.isEmpty()) LoadBannList(database.BannList(), list);
}
