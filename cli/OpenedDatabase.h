#pragma once

#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/commands/Rules.h"
#include "MusicManagment/database/songfiles/SongUpdates.h"
#include "cli/Arguments.h"
#include "cli/Console.h"
#include "cli/RunWatcher.h"

// Makes the database one of a program without windows: no events to wait for, and the modern rules unless the
// user wants the classic ones.
void PrepareDatabase(TMusicDatabase& database, Rules rules = Rules::Modern);

// Keeps other programs from writing the file that the command is going to write. Throws EAbort, after telling
// the user, when one has it open.
void ClaimFile(TMusicDatabase& database, const QString& fileName);

// Reads the file into the database. Throws EMusicDatabaseException with the reason; also when the user
// stopped.
void ReadInto(TMusicDatabase& database, const QString& fileName, Console& console, StopBy stopBy);

// For a command that changes songs and their files: keeps others from writing the database, reads it, and
// saves it after each command from then on. With `onlyReads` it is only read.
void OpenForChanges(TMusicDatabase& database, const QString& fileName, bool onlyReads, Console& console);

inline constexpr OptionRow kClassicChangesOption = {
    u"--classic", u"",
    u"nach den ursprünglichen Regeln des Programms; umbenannte Dateien wandern in den Stammordner"};
inline constexpr OptionRow kDryRunOption = {u"--dry-run", u"", u"zeigt nur, was geschehen würde"};

// Tells what went wrong; false when anything did, or the user stopped.
bool ReportChanges(const BatchResult& result, Console& console);

inline constexpr OptionRow kBannListOption = {
    u"--bannlist", u"DATEI",
    u"Bann-Liste (.str), deren Songs nicht aufgenommen werden; ohne die Option\n"
    u"gilt für die Standard-Datenbank die Standard-Bann-Liste"};
// The ban list that goes with a database: that of the option, else the standard one of the standard database,
// whether or not it is there; empty for others.
QString BannListFor(const QString& fileName, const Arguments& arguments);
// Loads the ban list of that option. Throws EStreamError when it cannot be read.
void LoadBannListFor(TMusicDatabase& database, const QString& fileName, const Arguments& arguments);
