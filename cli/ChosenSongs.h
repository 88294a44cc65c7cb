#pragma once

#include "MusicManagment/database/MusicManagment.h"
#include "cli/Arguments.h"
#include "cli/Console.h"

// The songs of a database that a command is about: all of them, those that a filter lets through, or those
// that are named by their paths.

inline constexpr OptionRow kAllOption = {u"--all", u"", u"alle Songs der Sammlung"};
inline constexpr OptionRow kFilterOption = {
    u"--filter", u"FILTER", u"die Songs, die der Filter durchlässt, wie im Filterfeld des Fensters"};

struct ChosenSongs {
    std::vector<SongHandle> Songs;  // in the order of the collection, named ones in their own
    bool AllFound = true;           // false: a path is not in the collection; the user has been told
};

// Throws EUsageError unless exactly one way is used, and for a filter with a field that is not known.
ChosenSongs ChooseSongs(const TMusicDatabase& database, const Arguments& arguments, Console& console);
// Those that the operands name.
ChosenSongs NamedSongs(const TMusicDatabase& database, const QStringList& paths, Console& console);
