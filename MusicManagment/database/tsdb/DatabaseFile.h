#pragma once

#include <QString>

#include "CommonRUKTools/FileSource.h"
#include "CommonRUKTools/SafeFile.h"

class TMusicDatabase;

// The database file ".tsdb", described in docs/formats.md: a header of 17 bytes and one zlib stream.

// Writes version 2.0. False when the user stopped the run: the file then holds the songs written so far, and
// the caller throws it away. Clears the database's Modified mark on success. Throws EStreamError.
bool WriteDatabase(TMusicDatabase& database, SafeFile& file);

// Reads versions 1.0, 1.1, 1.2 and 2.0 into the database, which is emptied first. False when the user stopped
// the run. Throws EMusicDatabaseException with the reason when the file is damaged; the songs read so far are
// kept.
bool ReadDatabase(TMusicDatabase& database, ByteSource& stream);

// For whoever changes something before the reading begins, which refuses in the same way: throws EAbort,
// after telling the user, while a run is going, and EMusicDatabaseException while the songs must not change.
void RefuseReadingNow(TMusicDatabase& database);
