#pragma once

#include <QString>
#include <QStringList>
#include <vector>

#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/songfiles/SongUpdates.h"

// Artists that may be one, spelt differently.

struct SimilarArtists {
    double Percent = 0;  // as CompStr has it
    QString First;
    QString Second;
    int FirstSongs = 0;
    int SecondSongs = 0;
};

// Pairs of artists whose names are alike by 60 percent, or sound alike and are still alike by 40; the most
// alike first, else in the order of the artists. A long operation. `stopped` tells that the user ended it,
// the pairs are then those found so far. Throws EAbort, after telling the user, when another operation runs.
std::vector<SimilarArtists> FindSimilarArtists(TMusicDatabase& database, bool& stopped);

// Gives all songs of these artists, as they are listed, the spelling `spelling`, in their tags too; one step
// that can be taken back. Throws what UpdateSongs throws.
BatchResult UnifyArtists(TMusicDatabase& database, const QStringList& artists, const QString& spelling);
