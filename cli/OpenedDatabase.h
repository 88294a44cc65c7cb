#pragma once

#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/commands/Rules.h"
#include "cli/Console.h"
#include "cli/RunWatcher.h"

// Makes the database one of a program without windows: no events to wait for, and the modern rules unless the
// user wants the classic ones.
void PrepareDatabase(TMusicDatabase& database, Rules rules = Rules::Modern);

// Reads the file into the database. Throws EMusicDatabaseException with the reason; also when the user
// stopped.
void ReadInto(TMusicDatabase& database, const QString& fileName, Console& console, StopBy stopBy);
