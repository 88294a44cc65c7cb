#pragma once

#include <QString>
#include <QStringList>

#include "MusicManagment/database/MusicManagment.h"
#include "ReadMPEGHeader/SongFileKinds.h"

// How songs enter the collection.

// What came of the files of one intake.
struct IntakeResult {
    int Added = 0;
    int Known = 0;  // already in the collection
    int Banned = 0;
    int Unreadable = 0;    // files and folders that could not be read or are not what their name says
    bool Stopped = false;  // the user asked to stop; what was taken in stays
    QStringList NewFiles;  // in the order in which they were taken in
    QStringList BannedFiles;
    QStringList DamagedFiles;     // taken in, but nothing was found in them that could be played
    QStringList UnreadableNames;  // each with the reason
};

// What becomes of the folders that an intake was given.
enum class GivenFolders {
    Searched,
    Remembered,  // also as folders for later updates
};

// Lets the user pick files (unless some are given), adds them and reports. What the user picks is read
// whatever its extension. Each command here saves when AutoSave is -1, before it reports, and throws
// EMusicDatabaseException while another long operation runs or the database must not change; then nothing is
// remembered either.
IntakeResult AddSongsFromDialog(TMusicDatabase& database, const QStringList& files = {});
// The same for a folder; without one the user picks it.
IntakeResult AddFolder(TMusicDatabase& database, const QString& folder, bool withSubfolders,
                       GivenFolders folders = GivenFolders::Searched);
// Files and folders together, as a drop or a command line gives them: one run and one result, without the
// report. A file without an accepted extension counts as unreadable. Relative and unclean paths are made
// absolute and clean (AbsolutePath.h), so that a song is not taken in twice under two spellings, and a folder
// that is reached by a link is the folder itself; a link to a file is a song of its own beside its target.
IntakeResult AddPaths(TMusicDatabase& database, const QStringList& paths, bool withSubfolders,
                      GivenFolders folders = GivenFolders::Searched);

// Adds every file of `list` inside a run that is already going; afterwards `list` holds only those taken in.
// With `checkExisting` files that are in the collection are passed over. Every 5th file is a progress point,
// where the user can stop; while a slow disk is waited for, too. Returns how many were taken in.
int AddFileList(TMusicDatabase& database, QStringList& list, bool checkExisting,
                QStringList* newNames = nullptr, IntakeResult* result = nullptr);
// Adds one file; -1 when it does not exist or could not be taken in.
SongIndex AddSongFile(TMusicDatabase& database, const QString& path, const SongOverrides& overrides = {});

// The message of the report, and the text of its details.
QString IntakeMessage(const IntakeResult& result);
QString IntakeDetails(const IntakeResult& result);
