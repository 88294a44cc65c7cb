#pragma once

#include "MusicManagment/database/MusicManagment.h"
#include "cli/Console.h"
#include "cli/RunWatcher.h"

// Makes the database one of a program without windows: modern reading profile, no events to wait for.
void PrepareDatabase(TMusicDatabase& database);

// Reads the file into the database. Throws EMusicDatabaseException with the reason; also when the user
// stopped.
void ReadInto(TMusicDatabase& database, const QString& fileName, Console& console, StopBy stopBy);
