#pragma once

#include <QStringList>

#include "MusicManagment/database/intake/Intake.h"

// Brings the collection up to date with the disk.

enum class UpdateTags {
    Keep,    // only look for new and removed songs
    Reread,  // also read every file again and take over changed tags
};

struct UpdateResult {
    IntakeResult Intake;
    QStringList Changed;         // paths of songs whose tags were taken over anew
    QStringList Removed;         // paths of songs that left the collection
    QStringList MissingFolders;  // update folders that are not there; their songs stay
    bool Stopped = false;
};

// Searches the update folders for new songs, finds songs whose files are gone, and removes those after the
// user has seen and confirmed the list. Songs below a folder that is not there (an unplugged disk, an empty
// mount point) stay. Reports to the user at the end. Throws EMusicDatabaseException while another run is
// going or when there are no update folders.
UpdateResult UpdateDatabase(TMusicDatabase& database, UpdateTags tags);

// `folders` and `more` in one list, in which no folder lies below another.
QStringList MergeFolders(QStringList folders, const QStringList& more);

// Remembers folders for later updates; one that lies below a remembered folder is not remembered twice.
void RememberFolders(TMusicDatabase& database, const QStringList& folders);

// Only searches the update folders for new songs, and reports.
IntakeResult SearchNewSongs(TMusicDatabase& database);

// The report of an update, and the text of its details.
QString UpdateMessage(const UpdateResult& result);
QString UpdateDetails(const UpdateResult& result);
