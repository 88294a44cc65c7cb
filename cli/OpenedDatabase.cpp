#include "cli/OpenedDatabase.h"

using namespace Qt::StringLiterals;

void PrepareDatabase(TMusicDatabase& database) {
    database.SetAsynchronous(false);
    database.SetModernTags(true);
    database.SetDerivedGenres(true);
}

void ReadInto(TMusicDatabase& database, const QString& fileName, Console& console, StopBy stopBy) {
    const RunWatcher watcher(database, console, stopBy);
    if (!database.OpenDatabase(fileName)) throw EMusicDatabaseException(u"Abgebrochen."_s);
}
