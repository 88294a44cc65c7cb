#pragma once

#include <QStringList>

#include "MusicManagment/database/batches/BatchSongs.h"

// The song-text tool, a program of its own that is given artists.

// Where the tool is looked for, one after the other; then where the system looks for programs.
struct LyricsToolPlaces {
    QString ProgramFolder;  // of this program; its sub-folder "LyrikfangDownloader", too
    QString StoredFolder;   // that the tool has put into the settings; may be empty
};
// Its path, with or without ".exe"; empty when it is nowhere.
QString FindLyricsTool(const LyricsToolPlaces& places);

// Each artist once, as a reader sorts them. A long operation unless it is about one song. Throws EAbort when
// the user ends it.
QStringList ArtistsOf(TMusicDatabase& database, const BatchSongs& songs);

// The artists as the command line shows them: between blanks, in double quotes where one holds a blank or a
// quote.
QString LyricsCommandLine(const QStringList& artists);

// Starts the tool with the artists of the songs; returns what was started, for the user. Nothing when it
// cannot be found, the user has then been told. Throws EMusicDatabaseException when the system does not start
// it.
QString LoadLyrics(TMusicDatabase& database, const BatchSongs& songs, const LyricsToolPlaces& places);
