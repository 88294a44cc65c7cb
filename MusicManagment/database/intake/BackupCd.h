#pragma once

#include "MusicManagment/database/MusicManagment.h"

// A backup CD holds copies of songs of the collection. A song that is tied to its copy is stored by that
// one's CD path from then on; its own file stays what and where it is.

struct BackupResult {
    int Tied = 0;
    int Added = 0;
    QStringList Failed;  // files and the reason
    bool Stopped = false;
};

// Lets the user choose the CD, reads it and asks for each file which song it is. What the user has decided
// when he stops is done; tied songs can be taken back as one.
BackupResult ReadBackupCd(TMusicDatabase& database);
void ReportBackupCd(const BackupResult& result);
