#pragma once

#include <QString>
#include <vector>

#include "MusicManagment/database/songfiles/SongUpdates.h"

// What renaming songs by a pattern comes to, before anything happens.
struct PlannedRename {
    SongMove Move;
    QString From;
    QString Problem{};  // what is in the way; empty where nothing is
};

// Songs whose names would stay are left out.
std::vector<PlannedRename> PlanRenames(const TMusicDatabase& database, const std::vector<SongHandle>& songs,
                                       const QString& pattern);
// Those that nothing is in the way of.
std::vector<SongMove> PossibleMoves(const std::vector<PlannedRename>& plans);
