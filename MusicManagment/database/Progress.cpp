#include "MusicManagment/database/Progress.h"

#include "MusicManagment/database/MusicManagment.h"

ProgressRun::ProgressRun(TMusicDatabase& database, const QString& description, Operation::Commands commands)
    : operation_(database.CurrentOperation()) {
    operation_.Start(description, commands);
}

void RefuseDuringRun(TMusicDatabase& database) {
    if (database.ProgressRunning()) const ProgressRun refused(database, QString());
}
