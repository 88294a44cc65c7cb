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
    QStringList Changed;  // paths of songs whose tags were taken over anew
    QStringList Removed;  // paths of songs that left the collection
    QStringList
        MissingFolders;  // folders that are not there or look like an unplugged disk; their songs stay
    bool Stopped = false;
};

// Searches the update folders for new songs, finds songs whose files are gone, and removes those after the
// user has seen and confirmed the list; about folders that have lost all their songs at once the user is
// asked apart. Songs below a folder that is not there (an unplugged disk, an empty mount point) stay. Saves
// when AutoSave is -1 and reports to the user at the end. Throws EMusicDatabaseException while another run is
// going or when there are no update folders.
UpdateResult UpdateDatabase(TMusicDatabase& database, UpdateTags tags);

// Only searches the update folders for new songs, and reports.
IntakeResult SearchNewSongs(TMusicDatabase& database);

// The report of an update, and the text of its details.
QString UpdateMessage(const UpdateResult& result);
QString UpdateDetails(const UpdateResult& result);
