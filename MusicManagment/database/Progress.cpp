#include "MusicManagment/database/Progress.h"

#include "MusicManagment/database/MusicManagment.h"

ProgressRun::ProgressRun(TMusicDatabase& database, const QString& description, bool lockMenu)
    : database_(database), lockMenu_(lockMenu) {
    database_.StartProgress(description, lockMenu);
}

ProgressRun::~ProgressRun() {
    database_.EndProgress(lockMenu_);
}

void RefuseDuringRun(TMusicDatabase& database) {
    if (database.ProgressRunning()) const ProgressRun refused(database, QString());
}
