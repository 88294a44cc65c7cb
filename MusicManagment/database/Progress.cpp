#include "MusicManagment/database/Progress.h"

#include "MusicManagment/database/MusicManagment.h"

ProgressRun::ProgressRun(TMusicDatabase& database, const QString& description, bool lockMenu)
    : database_(database), lockMenu_(lockMenu) {
    database_.StartProgress(description, lockMenu);
}

ProgressRun::~ProgressRun() {
    database_.EndProgress(lockMenu_);
}

BusyGuard::BusyGuard(TMusicDatabase& database) : database_(database) {
    database_.BeginBusy();
}

BusyGuard::~BusyGuard() {
    database_.EndBusy();
}

void RefuseDuringRun(TMusicDatabase& database) {
    if (database.ProgressRunning()) const ProgressRun refused(database, QString());
}
